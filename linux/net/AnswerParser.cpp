#include "linux/net/AnswerParser.h"

#include <boost/beast/http/parser.hpp>
#include <boost/beast/http/string_body.hpp>
#include <iterator>

namespace ktr::linux_ {

namespace http = boost::beast::http;

struct AnswerParser::Parser {
    http::response_parser<http::string_body> beast;
};

namespace {

constexpr unsigned kHttp10 = 10;
constexpr unsigned kHttp11 = 11;
constexpr int kFirstStatus = 100;
constexpr int kSwitchingProtocols = 101;
constexpr int kFirstFinalStatus = 200;
constexpr int kNoContent = 204;
constexpr int kNotModified = 304;

}  // namespace

AnswerParser::AnswerParser(std::size_t maximumBytes) : maximumBytes_(maximumBytes) {
    restart();
}

AnswerParser::~AnswerParser() = default;

void AnswerParser::restart() {
    parser_ = std::make_unique<Parser>();
    // Room for a body is made as soon as there is a byte of it: not before the header has been looked at.
    parser_->beast.eager(false);
    parser_->beast.header_limit(static_cast<std::uint32_t>(kLargestHead));
    parser_->beast.body_limit(maximumBytes_);
    headIsChecked_ = false;
}

AnswerParser::State AnswerParser::give(State state, const char* trouble) {
    state_ = state;
    trouble_ = trouble;
    pending_.clear();
    return state_;
}

void AnswerParser::headArrived() {
    headIsChecked_ = true;
    const auto& answer = parser_->beast.get();
    const bool hasBody = status() >= kFirstFinalStatus && status() != kNoContent && status() != kNotModified;
    if (answer.version() != kHttp10 && answer.version() != kHttp11) {
        give(State::Broken, "the answer is of another version of HTTP");
    } else if (static_cast<std::size_t>(std::distance(answer.begin(), answer.end())) > kMostFields) {
        give(State::TooLarge, "the answer's header is too large");
    } else if (status() < kFirstStatus) {
        give(State::Broken, "the answer is no proper HTTP");
    } else if (hasBody && parser_->beast.content_length().value_or(0) > maximumBytes_) {
        // The parser sees it too, but passes over it where a part of the body has come with the header.
        give(State::TooLarge, "the answer is too large");
    } else if (answer.count(http::field::transfer_encoding) != 0 && !parser_->beast.chunked()) {
        // It would be read up to the end of the connection, unfolded or not.
        give(State::Broken, "the answer is coded in an unknown way");
    } else if (status() == kSwitchingProtocols) {
        give(State::Broken, "the answer changes the protocol");
    } else if (status() < kFirstFinalStatus && ++interimAnswers_ > kMostInterimAnswers) {
        give(State::TooLarge, "the answer is put off too often");
    }
}

AnswerParser::State AnswerParser::feed(std::string_view bytes) {
    if (state_ != State::Incomplete) {
        return state_;
    }
    pending_.append(bytes);
    // Chunks end with five bytes at least. Boost 1.74 asserts that it has them when it looks at the last chunk again.
    const auto least = [&] { return headIsChecked_ && parser_->beast.chunked() ? std::size_t{5} : std::size_t{1}; };
    while (pending_.size() >= least()) {
        boost::beast::error_code error;
        const std::size_t taken =
            parser_->beast.put(boost::asio::const_buffer(pending_.data(), pending_.size()), error);
        pending_.erase(0, taken);
        if (error == http::error::header_limit) {
            return give(State::TooLarge, "the answer's header is too large");
        }
        if (error == http::error::body_limit || error == http::error::buffer_overflow) {
            return give(State::TooLarge, "the answer is too large");
        }
        if (error && error != http::error::need_more) {
            return give(State::Broken, "the answer is no proper HTTP");
        }
        if (parser_->beast.is_header_done() && !headIsChecked_) {
            headArrived();
            if (state_ != State::Incomplete) {
                return state_;
            }
            parser_->beast.eager(true);
        }
        if (parser_->beast.is_done()) {
            if (status() >= kFirstFinalStatus) {
                return give(State::Whole, "");
            }
            restart();
        } else if (error == http::error::need_more) {
            break;
        }
    }
    if (pending_.size() > kLargestHead) {
        return give(State::TooLarge, "a line of the answer is too long");
    }
    return state_;
}

AnswerParser::State AnswerParser::end() {
    if (state_ != State::Incomplete) {
        return state_;
    }
    if (!parser_->beast.got_some()) {
        return give(State::Broken, "the connection ended without an answer");
    }
    boost::beast::error_code error;
    parser_->beast.put_eof(error);
    return error || !parser_->beast.is_done() ? give(State::Broken, "the connection ended within the answer")
                                              : give(State::Whole, "");
}

int AnswerParser::status() const {
    return static_cast<int>(parser_->beast.get().result_int());
}

std::string AnswerParser::field(std::string_view name) const {
    const auto& answer = parser_->beast.get();
    const auto found = answer.find({name.data(), name.size()});
    return found != answer.end() ? std::string(found->value()) : std::string();
}

std::string AnswerParser::takePiece() {
    constexpr int kOk = 200;
    return headIsChecked_ && status() == kOk ? std::exchange(parser_->beast.get().body(), {}) : std::string();
}

std::string AnswerParser::takeBody() {
    return std::move(parser_->beast.get().body());
}

}  // namespace ktr::linux_
