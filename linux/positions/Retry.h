#pragma once

#include <algorithm>
#include <functional>
#include <memory>
#include <utility>

#include "platform/base/MainLoop.h"

namespace ktr::linux_ {

/// Tries again after pauses that double, from one second to a minute. Main thread.
class Retry {
  public:
    Retry(std::shared_ptr<platform::MainLoop> mainLoop, std::function<void()> attempt)
        : mainLoop_(std::move(mainLoop)), attempt_(std::make_shared<std::function<void()>>(std::move(attempt))) {}
    ~Retry() { cancel(); }
    Retry(const Retry&) = delete;
    Retry& operator=(const Retry&) = delete;

    /// Plans the next attempt, unless one is planned.
    void later() {
        if (timer_ && timer_->isValid()) {
            return;
        }
        timer_ = mainLoop_->schedule(pause_, false, [weak = std::weak_ptr(attempt_)] {
            if (const auto attempt = weak.lock()) {
                (*attempt)();
            }
        });
        pause_ = std::min(pause_ * 2.0, kLongest);
    }
    void cancel() {
        if (timer_) {
            timer_->invalidate();
        }
    }
    /// After a success: the next pause is short again.
    void succeeded() { pause_ = kShortest; }

  private:
    static constexpr double kShortest = 1.0;
    static constexpr double kLongest = 60.0;

    std::shared_ptr<platform::MainLoop> mainLoop_;
    std::shared_ptr<std::function<void()>> attempt_;
    std::shared_ptr<platform::Timer> timer_;
    double pause_ = kShortest;
};

}  // namespace ktr::linux_
