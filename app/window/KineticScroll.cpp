#include "app/window/KineticScroll.h"

#include <cmath>

namespace ktr::app {

void KineticScroll::press(double y, double time) {
    stop();
    trail_.begin({0.0, y}, time);
}

double KineticScroll::drag(double y, double time) {
    // The content goes the other way.
    return -trail_.move({0.0, y}, time).y();
}

void KineticScroll::release(double time) {
    const double speed = -trail_.release(time).y();
    if (std::abs(speed) >= kSlowest) {
        velocity_ = speed;
    }
    lastTime_ = time;
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
