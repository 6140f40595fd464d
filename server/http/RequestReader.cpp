#include "server/http/RequestReader.h"

#include <utility>
// Boost 1.74 forgets to include <utility>.
#include <algorithm>
#include <boost/asio/buffer.hpp>
#include <boost/beast/http/message.hpp>
#include <boost/beast/http/parser.hpp>
#include <boost/beast/http/string_body.hpp>

namespace ktr::server {

namespace http = boost::beast::http;

namespace {

std::string textOf(boost::beast::string_view text) {
    return {text.data(), text.size()};
}

bool isDigits(std::string_view text) {
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

/// Headers that mean nothing sensible when they come twice.
constexpr const char* kOnce[] = {
    "Host", "Content-Length", "Transfer-Encoding", "Authorization", "Content-Type", "Content-Encoding", "Expect"};

}  // namespace

struct RequestReader::Parser {
    explicit Parser(const HttpLimits& limits) {
        message.header_limit(static_cast<std::uint32_t>(limits.headerBytes));
        message.body_limit(limits.bodyBytes);
        message.eager(false);
    }
    /// How many bytes were used.
    std::size_t put(std::string_view bytes) {
        return message.put(boost::asio::const_buffer(bytes.data(), bytes.size()), failure);
    }

    http::request_parser<http::string_body> message;
    boost::beast::error_code failure;
};

RequestReader::RequestReader(const HttpLimits& limits) : limits_(limits), parser_(std::make_unique<Parser>(limits)) {}

RequestReader::~RequestReader() = default;

RequestReader::State RequestReader::refuse(int status, std::string complaint) {
    status_ = status;
    complaint_ = std::move(complaint);
    waiting_.clear();
    return state_ = State::Refused;
}

RequestReader::State RequestReader::feed(std::string_view bytes) {
    if (state_ == State::Done || state_ == State::Refused) {
        return state_;
    }
    waiting_ += bytes;
    if (state_ == State::Body) {
        bodyBytes_ += bytes.size();
        return readBody();
    }
    return readHeader();
}

RequestReader::State RequestReader::next() {
    parser_ = std::make_unique<Parser>(limits_);
    request_ = {};
    scanned_ = 0;
    bodyBytes_ = 0;
    state_ = State::Header;
    if (waiting_.empty()) {
        waiting_.shrink_to_fit();
        return state_;
    }
    return readHeader();
}

RequestReader::State RequestReader::readHeader() {
    std::size_t end = std::string::npos;
    for (std::size_t i = scanned_; i < waiting_.size() && end == std::string::npos; ++i) {
        const char letter = waiting_[i];
        const char before = i > 0 ? waiting_[i - 1] : '\0';
        if (letter == '\0' || (letter == '\n') != (before == '\r')) {
            return refuse(400, "a line of the header does not end with CR LF");
        }
        if ((letter == ' ' || letter == '\t') && before == '\n') {
            return refuse(400, "a line of the header is folded");
        }
        if (letter == '\n' && i >= 3 && waiting_[i - 2] == '\n') {
            end = i + 1;
        }
    }
    scanned_ = waiting_.size();
    if (end == std::string::npos) {
        return waiting_.size() >= limits_.headerBytes ? refuse(431, "the header is too long") : state_;
    }
    if (end > limits_.headerBytes) {
        return refuse(431, "the header is too long");
    }
    const std::size_t used = parser_->put(std::string_view(waiting_).substr(0, end));
    if (parser_->failure == http::error::body_limit) {
        return checkHeader() == State::Refused ? state_ : refuse(413, "the body is too long");
    }
    if (parser_->failure || !parser_->message.is_header_done() || used != end) {
        return refuse(400, "the header is not one of HTTP/1.1");
    }
    waiting_.erase(0, end);
    if (checkHeader() == State::Refused) {
        return state_;
    }
    if (parser_->message.is_done()) {
        return state_ = State::Done;
    }
    state_ = State::Body;
    bodyBytes_ = waiting_.size();
    parser_->message.eager(true);
    return waiting_.empty() ? state_ : readBody();
}

RequestReader::State RequestReader::checkHeader() {
    const auto& message = parser_->message.get();
    const std::string target = textOf(message.target());
    const std::size_t mark = target.find('?');
    request_.method = textOf(message.method_string());
    request_.path = target.substr(0, mark);
    request_.query = mark == std::string::npos ? "" : target.substr(mark + 1);
    for (const auto& field : message) {
        request_.headers.emplace_back(textOf(field.name_string()), textOf(field.value()));
    }
    if (request_.headers.size() > limits_.headerFields) {
        return refuse(431, "the header has too many fields");
    }
    for (const char* name : kOnce) {
        const auto count = std::count_if(request_.headers.begin(), request_.headers.end(),
                                         [&](const auto& header) { return equalIgnoringCase(header.first, name); });
        if (count > 1) {
            return refuse(400, std::string("the header has more than one ") + name);
        }
    }
    if (request_.path.empty() || request_.path.front() != '/' || target.find('#') != std::string::npos) {
        return refuse(400, "the target is not a path");
    }
    const bool isNew = message.version() >= 11;
    if (isNew && request_.header("Host") == nullptr) {
        return refuse(400, "the header has no Host");
    }
    if (const std::string* coding = request_.header("Transfer-Encoding")) {
        if (!isNew || request_.header("Content-Length") != nullptr) {
            return refuse(400, "the header has chunks where none may be");
        }
        if (!equalIgnoringCase(*coding, "chunked")) {
            return refuse(501, "the body has a coding other than chunked");
        }
    }
    if (const std::string* length = request_.header("Content-Length"); length != nullptr && !isDigits(*length)) {
        return refuse(400, "the length of the body is no number");
    }
    // Nothing is unpacked: a few bytes would become as many as their sender likes.
    if (const std::string* packing = request_.header("Content-Encoding");
        packing != nullptr && !packing->empty() && !equalIgnoringCase(*packing, "identity")) {
        return refuse(415, "the body is packed");
    }
    if (const std::string* expected = request_.header("Expect");
        expected != nullptr && !equalIgnoringCase(*expected, "100-continue")) {
        return refuse(417, "the header expects what is not known");
    }
    return state_;
}

RequestReader::State RequestReader::readBody() {
    // Chunks end with five bytes at least. Boost 1.74 asserts that it has them when it looks at the last chunk again.
    const std::size_t least = parser_->message.chunked() ? 5 : 1;
    std::size_t used = 0;
    while (used + least <= waiting_.size() && !parser_->message.is_done()) {
        const std::size_t step = parser_->put(std::string_view(waiting_).substr(used));
        used += step;
        if (parser_->failure == http::error::need_more) {
            break;
        }
        if (parser_->failure == http::error::body_limit) {
            return refuse(413, "the body is too long");
        }
        if (parser_->failure || step == 0) {
            return refuse(400, "the body is not in chunks as announced");
        }
    }
    waiting_.erase(0, used);
    if (parser_->message.is_done()) {
        request_.body = std::move(parser_->message.get().body());
        return state_ = State::Done;
    }
    // A chunk's line or a trailer without end; and small chunks with long lines.
    if (waiting_.size() >= limits_.headerBytes || bodyBytes_ > 2 * limits_.bodyBytes + limits_.headerBytes) {
        return refuse(413, "the body has more around it than in it");
    }
    return state_;
}

bool RequestReader::wantsContinue() const {
    return state_ == State::Body && bodyBytes_ == 0 && request_.header("Expect") != nullptr;
}

HttpRequest RequestReader::take() {
    return std::exchange(request_, {});
}

bool RequestReader::keepsAlive() const {
    return state_ == State::Done && parser_->message.get().keep_alive();
}

}  // namespace ktr::server
