#pragma once

#include <ctime>

#include <memory>
#include <utility>

#include "platform/base/Clock.h"

namespace ktr::linux_ {

/// A clock for ages: it starts at another clock's time and then runs evenly, also while the machine sleeps, whatever
/// happens to the other one. A phone that learns the time from the network after its start leaps by years. Any thread.
class EvenClock : public platform::Clock {
  public:
    explicit EvenClock(std::shared_ptr<platform::Clock> clock)
        : clock_(std::move(clock)), start_(clock_->now()), made_(sinceBoot()) {}

    platform::Date now() const override { return {start_.secondsSinceReferenceDate + sinceBoot() - made_}; }
    /// What the other clock calls a moment of this one.
    platform::Date onTheOther(platform::Date moment) const {
        const double age = now().secondsSinceReferenceDate - moment.secondsSinceReferenceDate;
        return {clock_->now().secondsSinceReferenceDate - age};
    }

  private:
    static double sinceBoot() {
        timespec time{};
        ::clock_gettime(CLOCK_BOOTTIME, &time);
        return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
    }

    std::shared_ptr<platform::Clock> clock_;
    platform::Date start_;
    double made_;
};

}  // namespace ktr::linux_
