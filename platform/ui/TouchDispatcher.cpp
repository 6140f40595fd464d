#include "platform/ui/TouchDispatcher.h"

#include <cmath>

namespace ktr::platform {

void TouchDispatcher::press(Point location, double timestamp) {
    cancel(timestamp);
    const auto root = root_.lock();
    const auto hit = root ? root->hitTest(location) : nullptr;
    if (!hit) {
        return;
    }
    target_ = hit;
    start_ = location;
    hit->touchesBegan({Touch{location}}, {timestamp});
}

void TouchDispatcher::move(Point location, double timestamp) {
    if (isPressed() && std::hypot(location.x - start_.x, location.y - start_.y) > kSlop) {
        cancel(timestamp);
    }
}

void TouchDispatcher::release(Point location, double timestamp) {
    move(location, timestamp);
    const auto target = target_.lock();
    target_.reset();
    if (!target) {
        return;
    }
    target->touchesEnded({Touch{location}}, {timestamp});
    for (auto view = target; view; view = view->superview()) {
        if (!view->gestureRecognizers().empty()) {
            const auto recognizers = view->gestureRecognizers();
            for (const auto& recognizer : recognizers) {
                recognizer->fire();
            }
            return;
        }
    }
}

void TouchDispatcher::cancel(double timestamp) {
    const auto target = target_.lock();
    target_.reset();
    if (target) {
        target->touchesCancelled({Touch{start_}}, {timestamp});
    }
}

}  // namespace ktr::platform
