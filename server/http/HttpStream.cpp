#include "server/http/HttpStream.h"

#include <utility>

namespace ktr::server {

bool HttpStream::send(const std::string& bytes) {
    std::function<void()> wake;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (ended_ || gone_ || waiting_.size() + bytes.size() > kMost) {
            return false;
        }
        waiting_ += bytes;
        wake = wake_;
    }
    if (wake) {
        wake();
    }
    return true;
}

void HttpStream::end(const std::string& last) {
    std::function<void()> wake;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        if (ended_ || gone_) {
            return;
        }
        ended_ = true;
        waiting_ = last;
        wake = wake_;
    }
    if (wake) {
        wake();
    }
}

bool HttpStream::isDrained() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return waiting_.empty() && !underWay_;
}

bool HttpStream::isOver() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return ended_ || gone_;
}

void HttpStream::attach(std::function<void()> wake) {
    const std::lock_guard<std::mutex> lock(mutex_);
    wake_ = std::move(wake);
}

std::string HttpStream::take() {
    std::string bytes;
    bool isDrained = false;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        bytes = std::exchange(waiting_, {});
        isDrained = bytes.empty() && underWay_ && !ended_;
        underWay_ = !bytes.empty();
    }
    if (isDrained && drained_) {
        drained_();
    }
    return bytes;
}

bool HttpStream::isFinished() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return ended_ && waiting_.empty();
}

void HttpStream::abandon() {
    const std::lock_guard<std::mutex> lock(mutex_);
    gone_ = true;
    waiting_.clear();
    wake_ = nullptr;
}

}  // namespace ktr::server
