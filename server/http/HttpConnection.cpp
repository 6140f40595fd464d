#include "server/http/HttpConnection.h"

#include <algorithm>
#include <array>

#include "platform/base/Json.h"
#include "server/http/ClientAddress.h"
#include "server/http/ConnectionTable.h"
#include "server/http/HttpStream.h"

namespace ktr::server {

namespace asio = boost::asio;

namespace {

constexpr std::size_t kReadSize = 16384;
/// How much of what a refused client still sends is read away, so that it gets to see why.
constexpr std::size_t kMostDropped = std::size_t{4} << 20;
constexpr std::chrono::milliseconds kDropTime{2000};
constexpr std::size_t kStep = 65536;
constexpr double kLongestPause = 3600.0;  // seconds

std::string chunk(const std::string& bytes) {
    constexpr char kDigits[] = "0123456789abcdef";
    std::string size;
    for (std::size_t rest = bytes.size(); rest > 0; rest /= 16) {
        size.insert(size.begin(), kDigits[rest % 16]);
    }
    return size + "\r\n" + bytes + "\r\n";
}

}  // namespace

HttpConnection::HttpConnection(std::shared_ptr<const Setup> setup, int descriptor, Client client)
    : setup_(std::move(setup)),
      client_(std::move(client)),
      descriptor_(asio::make_strand(*setup_->loop), descriptor),
      deadline_(descriptor_.get_executor()),
      pace_(descriptor_.get_executor()),
      bytes_(descriptor, setup_->tls.get()),
      reader_(setup_->limits) {}

HttpConnection::~HttpConnection() = default;

void HttpConnection::start() {
    asio::post(descriptor_.get_executor(), [self = shared_from_this()] {
        self->headerBegun_ = true;
        self->setDeadline(self->setup_->limits.headerTime);
        self->receive();
    });
}

void HttpConnection::close() {
    asio::post(descriptor_.get_executor(), [self = shared_from_this()] { self->closeNow(); });
}

void HttpConnection::closeNow() {
    if (closed_) {
        return;
    }
    closed_ = true;
    answering_ = false;
    if (stream_) {
        std::exchange(stream_, nullptr)->abandon();
    }
    deadline_.cancel();
    pace_.cancel();
    boost::system::error_code ignored;
    descriptor_.close(ignored);
    setup_->table->remove(*this);
}

void HttpConnection::setDeadline(std::chrono::milliseconds time) {
    deadline_.expires_after(time);
    deadline_.async_wait([self = shared_from_this()](const boost::system::error_code& failure) {
        // A timer that was set anew may have run out before.
        if (!failure && self->deadline_.expiry() <= std::chrono::steady_clock::now()) {
            ++self->setup_->counters->outOfTime;
            self->closeNow();
        }
    });
}

void HttpConnection::waitFor(ByteSocket::Result what, void (HttpConnection::*then)()) {
    const auto kind = what == ByteSocket::Result::WaitToRead ? asio::posix::descriptor_base::wait_read
                                                             : asio::posix::descriptor_base::wait_write;
    descriptor_.async_wait(kind, [self = shared_from_this(), then](const boost::system::error_code& failure) {
        if (failure) {
            self->closeNow();
        } else if (!self->closed_) {
            (self.get()->*then)();
        }
    });
}

void HttpConnection::receive() {
    std::array<char, kReadSize> block;
    while (!closed_) {
        const auto [result, count] = bytes_.read(block.data(), block.size());
        if (result == ByteSocket::Result::End) {
            return closeNow();
        }
        if (result != ByteSocket::Result::Some) {
            return waitFor(result, &HttpConnection::receive);
        }
        const auto state = reader_.feed(std::string_view(block.data(), count));
        act(state);
        if (state == RequestReader::State::Done || state == RequestReader::State::Refused) {
            return;
        }
    }
}

void HttpConnection::act(RequestReader::State state) {
    switch (state) {
        case RequestReader::State::Header:
            if (!headerBegun_ && reader_.begun()) {
                headerBegun_ = true;
                setDeadline(setup_->limits.headerTime);
            }
            break;
        case RequestReader::State::Body:
            if (!inBody_) {
                inBody_ = true;
                setDeadline(setup_->limits.bodyTime);
                if (reader_.wantsContinue()) {
                    // So short a text always finds room in an idle connection.
                    bytes_.write("HTTP/1.1 100 Continue\r\n\r\n");
                }
            }
            break;
        case RequestReader::State::Done:
            answerRequest(setup_->handler);
            break;
        case RequestReader::State::Refused:
            if (reader_.status() == 413 && setup_->tooLong) {
                answerRequest(setup_->tooLong);
            } else {
                refuse();
            }
            break;
    }
}

void HttpConnection::answerRequest(const HttpHandler& handler) {
    deadline_.cancel();
    keepsAlive_ = reader_.keepsAlive();
    answering_ = true;
    setup_->table->setAnswering(*this, true);
    HttpRequest request = reader_.take();
    tellClient(request);
    const bool isHead = request.method == "HEAD";
    if (isHead) {
        request.method = "GET";
    }
    HttpReply reply([weak = weak_from_this(), isHead](std::optional<HttpResponse> response) {
        const auto self = weak.lock();
        if (!self) {
            return;
        }
        asio::post(self->descriptor_.get_executor(), [self, isHead, answer = std::move(response)]() mutable {
            if (!answer || self->closed_) {
                return self->closeNow();
            }
            if (isHead) {
                answer->delivery.cutAfter = 0;
                answer->stream.reset();
                self->keepsAlive_ = false;
            }
            self->send(std::move(*answer));
        });
    });
    handler(std::move(request), std::move(reply));
}

void HttpConnection::tellClient(HttpRequest& request) const {
    const bool isForwarded = ClientAddress::isForwarded(request);
    // Only a proxy on this machine is believed: over the network anybody could write these headers.
    request.peer = client_.address.empty() && isForwarded ? ClientAddress::forwardedFor(request) : client_.address;
    request.isLocal = client_.isLocal && !isForwarded;
}

void HttpConnection::refuse() {
    ++setup_->counters->refusedRequests;
    keepsAlive_ = false;
    const platform::Dictionary body{{"statusCode", reader_.status()}, {"message", reader_.complaint()}};
    send(HttpResponse::json(reader_.status(), platform::writeJson(body)));
}

void HttpConnection::send(HttpResponse response) {
    delivery_ = response.delivery;
    if (delivery_.reset) {
        bytes_.reset();
        return closeNow();
    }
    keepsAlive_ = keepsAlive_ && delivery_ == HttpDelivery() && !response.stream;
    out_ = response.head(keepsAlive_);
    sent_ = 0;
    if (response.stream) {
        // It may go on for days: nobody waits for its end.
        answering_ = false;
        stream_ = std::move(response.stream);
        out_ += response.body.empty() ? std::string() : chunk(std::exchange(response.body, {}));
        stream_->attach([weak = weak_from_this()] {
            if (const auto self = weak.lock()) {
                asio::post(self->descriptor_.get_executor(), [self] { self->resumeStream(); });
            }
        });
    }
    rest_ = delivery_.endless ? std::string() : std::move(response.body);
    rest_.resize(std::min(rest_.size(), delivery_.cutAfter.value_or(rest_.size())));
    if (delivery_.bytesPerSecond <= 0.0) {
        out_ += std::exchange(rest_, {});
    }
    setDeadline(setup_->limits.answerTime);
    sendMore();
}

void HttpConnection::sendMore() {
    while (!closed_ && sent_ < out_.size()) {
        const auto [result, count] = bytes_.write(std::string_view(out_).substr(sent_, kStep));
        if (result == ByteSocket::Result::End) {
            return closeNow();
        }
        if (result != ByteSocket::Result::Some) {
            return waitFor(result, &HttpConnection::sendMore);
        }
        if (sent_ / kStep != (sent_ + count) / kStep) {
            setDeadline(setup_->limits.answerTime);
        }
        sent_ += count;
    }
    if (closed_) {
        return;
    }
    if (stream_) {
        return sendNextOfStream();
    }
    if (delivery_.endless || !rest_.empty()) {
        return sendNextPiece();
    }
    finishAnswer();
}

void HttpConnection::resumeStream() {
    if (!closed_ && stream_ && sent_ == out_.size()) {
        sendNextOfStream();
    }
}

void HttpConnection::sendNextOfStream() {
    std::string piece = stream_->take();
    if (!piece.empty()) {
        out_ = chunk(piece);
    } else if (stream_->isFinished()) {
        stream_.reset();
        out_ = chunk("");
    } else {
        // The next bytes have their own time.
        deadline_.cancel();
        return;
    }
    sent_ = 0;
    setDeadline(setup_->limits.answerTime);
    sendMore();
}

void HttpConnection::sendNextPiece() {
    const std::size_t step = delivery_.bytesPerSecond > 0.0 ? 1 : kStep;
    out_ = delivery_.endless ? chunk(std::string(step, ' ')) : rest_.substr(0, step);
    sent_ = 0;
    if (!delivery_.endless) {
        rest_.erase(0, step);
    }
    const std::chrono::duration<double> pause(
        delivery_.bytesPerSecond > 0.0 ? std::min(kLongestPause, 1.0 / delivery_.bytesPerSecond) : 0.0);
    const auto wait = std::chrono::duration_cast<std::chrono::milliseconds>(pause);
    setDeadline(setup_->limits.answerTime + wait);
    pace_.expires_after(wait);
    pace_.async_wait([self = shared_from_this()](const boost::system::error_code& failure) {
        if (!failure && !self->closed_) {
            self->sendMore();
        }
    });
}

void HttpConnection::finishAnswer() {
    out_ = {};
    answering_ = false;
    if (!keepsAlive_) {
        bytes_.endWriting();
        setDeadline(kDropTime);
        return dropWhatComes();
    }
    setup_->table->setAnswering(*this, false);
    const auto state = reader_.next();
    headerBegun_ = reader_.begun();
    inBody_ = false;
    setDeadline(headerBegun_ ? setup_->limits.headerTime : setup_->limits.idleTime);
    act(state);
    if (state == RequestReader::State::Header || state == RequestReader::State::Body) {
        receive();
    }
}

void HttpConnection::dropWhatComes() {
    std::array<char, kReadSize> block;
    while (!closed_) {
        const auto [result, count] = bytes_.read(block.data(), block.size());
        dropped_ += count;
        if (result == ByteSocket::Result::End || dropped_ > kMostDropped) {
            return closeNow();
        }
        if (result != ByteSocket::Result::Some) {
            return waitFor(result, &HttpConnection::dropWhatComes);
        }
    }
}

}  // namespace ktr::server
