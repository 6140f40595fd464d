#pragma once

#include <optional>

#include "app/window/DragTrail.h"

namespace ktr::app {

/// A finger's drag and what it leaves behind: the distance follows the finger, and a fling runs on, slowing down.
/// Points and seconds; the caller passes the time.
class KineticScroll {
  public:
    /// A fling slower than this, in points a second, stands.
    static constexpr double kSlowest = 20.0;
    /// After so many seconds a fling has lost all but 1/e of its speed.
    static constexpr double kTimeConstant = 0.325;

    void press(double y, double time);
    /// How far the content moves, positive downwards through the content.
    double drag(double y, double time);
    /// Lets go: a fling begins when the finger was moving.
    void release(double time);
    void stop() { velocity_.reset(); }
    bool isFlinging() const { return velocity_.has_value(); }
    /// How far the content moves by itself until `time`.
    double step(double time);

  private:
    DragTrail trail_;
    double lastTime_ = 0.0;
    std::optional<double> velocity_;
};

}  // namespace ktr::app
