#include "platform/ui/Animation.h"

#include <algorithm>
#include <utility>

#include "platform/base/Assert.h"
#include "platform/base/Clock.h"
#include "platform/base/MainLoop.h"
#include "platform/base/Platform.h"
#include "platform/ui/Appearance.h"

namespace ktr::platform {

namespace {

constexpr double kFrame = 1.0 / 60.0;  // seconds

/// The block that is running, of the installed platform.
struct AnimationScope {
    static std::shared_ptr<AnimationScope> makeShared() { return std::make_shared<AnimationScope>(); }
    double duration = 0.0;
};

double bezier(double a, double b, double t) {
    const double u = 1.0 - t;
    return 3.0 * u * u * t * a + 3.0 * u * t * t * b + t * t * t;
}

}  // namespace

std::shared_ptr<Animation> Animation::start(double seconds, Step step) {
    KTR_ASSERT_MAIN_THREAD();
    auto animation = std::make_shared<Animation>();
    const auto installed = Platform::installed();
    const bool still = installed && installed->appearance && installed->appearance->reducesMotion();
    if (!(seconds > 0.0) || still || !installed || !installed->mainLoop || !installed->clock) {
        step(1.0);
        return animation;
    }
    animation->step_ = std::move(step);
    animation->duration_ = seconds;
    animation->start_ = installed->clock->now().secondsSinceReferenceDate;
    // Both timers hold the animation; ending it drops them.
    animation->frames_ = installed->mainLoop->schedule(kFrame, true, [animation] { animation->frame(); });
    animation->last_ = installed->mainLoop->schedule(seconds, false, [animation] { animation->end(); });
    return animation;
}

void Animation::stop() {
    step_ = nullptr;
    for (auto* timer : {&frames_, &last_}) {
        if (const auto stopped = std::exchange(*timer, nullptr)) {
            stopped->invalidate();
        }
    }
}

void Animation::frame() {
    const auto installed = Platform::installed();
    if (!step_ || !installed || !installed->clock) {
        stop();
        return;
    }
    const double part = (installed->clock->now().secondsSinceReferenceDate - start_) / duration_;
    if (part >= 1.0) {
        end();
        return;
    }
    // The step may stop or replace this animation.
    const Step step = step_;
    step(eased(std::max(part, 0.0)));
}

void Animation::end() {
    const Step step = std::exchange(step_, nullptr);
    stop();
    if (step) {
        step(1.0);
    }
}

void Animation::animate(double seconds, const std::function<void()>& block) {
    const auto scope = shared<AnimationScope>();
    if (!scope) {
        block();
        return;
    }
    const double outer = std::exchange(scope->duration, seconds);
    block();
    scope->duration = outer;
}

double Animation::currentDuration() {
    const auto scope = shared<AnimationScope>();
    return scope ? scope->duration : 0.0;
}

double Animation::eased(double part) {
    constexpr double x1 = 0.4;
    constexpr double y1 = 0.0;
    constexpr double x2 = 0.2;
    constexpr double y2 = 1.0;
    const double x = std::clamp(part, 0.0, 1.0);
    double low = 0.0;
    double high = 1.0;
    // x grows with t: thirty halvings settle t to a billionth.
    for (int i = 0; i < 30; ++i) {
        const double middle = (low + high) / 2.0;
        (bezier(x1, x2, middle) < x ? low : high) = middle;
    }
    return x <= 0.0 ? 0.0 : x >= 1.0 ? 1.0 : bezier(y1, y2, (low + high) / 2.0);
}

}  // namespace ktr::platform
