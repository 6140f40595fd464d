#include "app/window/KineticScroll.h"

#include <cmath>

namespace ktr::app {

namespace {

/// Only the last moments of a drag tell how fast the finger was when it let go, seconds.
constexpr double kMemory = 0.1;

}  // namespace

void KineticScroll::press(double y, double time) {
    stop();
    samples_.assign(1, {y, time});
}

double KineticScroll::drag(double y, double time) {
    if (samples_.empty()) {
        press(y, time);
        return 0.0;
    }
    const double moved = samples_.back().y - y;
    samples_.push_back({y, time});
    while (samples_.size() > 2 && time - samples_.front().time > kMemory) {
        samples_.pop_front();
    }
    return moved;
}

void KineticScroll::release(double time) {
    if (samples_.size() >= 2 && time - samples_.back().time <= kMemory) {
        const double seconds = samples_.back().time - samples_.front().time;
        const double moved = samples_.front().y - samples_.back().y;
        if (seconds > 0.0 && std::abs(moved / seconds) >= kSlowest) {
            velocity_ = moved / seconds;
        }
    }
    lastTime_ = time;
    samples_.clear();
}

double KineticScroll::step(double time) {
    if (!velocity_) {
        return 0.0;
    }
    const double rest = std::exp(-(time - lastTime_) / kTimeConstant);
    const double moved = *velocity_ * kTimeConstant * (1.0 - rest);
    lastTime_ = time;
    velocity_ = *velocity_ * rest;
    if (std::abs(*velocity_) < kSlowest) {
        stop();
    }
    return moved;
}

}  // namespace ktr::app
