#pragma once

#include <memory>

#include "platform/ui/View.h"

namespace ktr::platform {

/// Turns a pointer's down, move and up into touches of the view under it and into taps. One pointer at a time. Main
/// thread.
class KTR_API TouchDispatcher {
  public:
    /// A touch that moves further than this, in points, is a scroll and no tap.
    static constexpr double kSlop = 10.0;

    explicit TouchDispatcher(std::weak_ptr<View> root) : root_(std::move(root)) {}

    /// Points in the root's coordinates; seconds since the reference date. A press while another is going on cancels
    /// that.
    void press(Point location, double timestamp);
    void move(Point location, double timestamp);
    /// Ends the touch and, when it did not move away, fires the tap recognisers of the view and its ancestors.
    void release(Point location, double timestamp);
    void cancel(double timestamp);
    bool isPressed() const { return !target_.expired(); }

  private:
    std::weak_ptr<View> root_;
    std::weak_ptr<View> target_;
    Point start_;
};

}  // namespace ktr::platform
