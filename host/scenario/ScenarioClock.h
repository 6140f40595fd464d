#pragma once

#include <chrono>

#include "platform/base/Clock.h"

namespace ktr::host {

/// A clock that starts at a scenario's moment and then runs as fast as time does, unmoved by changes of the system's
/// clock. Any thread.
class ScenarioClock : public platform::Clock {
  public:
    explicit ScenarioClock(platform::Date start) : start_(start), made_(std::chrono::steady_clock::now()) {}
    platform::Date now() const override {
        const std::chrono::duration<double> passed = std::chrono::steady_clock::now() - made_;
        return {start_.secondsSinceReferenceDate + passed.count()};
    }

  private:
    platform::Date start_;
    std::chrono::steady_clock::time_point made_;
};

}  // namespace ktr::host
