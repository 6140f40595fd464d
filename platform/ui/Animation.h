#pragma once

#include <functional>
#include <memory>

#include "platform/base/Object.h"
#include "platform/base/Timer.h"

namespace ktr::platform {

/// Something that changes smoothly for a while. It lives until it has ended, whoever drops it. Main thread.
class KTR_API Animation : public Object {
  public:
    /// Is told how much of the way is done, from 0 to 1, eased; the last call says exactly 1. It captures weakly.
    using Step = std::function<void(double progress)>;

    /// Steps sixty times a second on the installed main loop and clock. At its end at once, before this returns, for a
    /// duration that is not greater than 0, while the user wants less motion, and without a main loop.
    static std::shared_ptr<Animation> start(double seconds, Step step);
    /// Leaves everything where it is at the moment.
    void stop();
    bool isRunning() const { return step_ != nullptr; }

    /// Runs the block at once. What it changes takes its new value at once, too; what is shown of it goes there within
    /// this time. (A view animation.)
    static void animate(double seconds, const std::function<void()>& block);
    /// Within a block of `animate`: its duration; else 0. Seconds.
    static double currentDuration();

    /// How far a motion has come when this part of its time has passed: the cubic curve (0.4, 0, 0.2, 1), as CSS Easing
    /// Functions defines it.
    static double eased(double part);

  private:
    void frame();
    void end();

    Step step_;
    double start_ = 0.0;
    double duration_ = 0.0;
    std::shared_ptr<Timer> frames_;
    std::shared_ptr<Timer> last_;
};

}  // namespace ktr::platform
