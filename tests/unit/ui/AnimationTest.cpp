#include "platform/ui/Animation.h"

#include <vector>

#include "tests/support/PlatformTest.h"

namespace ktr::test {

using platform::Animation;

class AnimationTest : public PlatformTest {
  protected:
    std::shared_ptr<Animation> start(double seconds = 0.5) {
        return Animation::start(seconds, [this](double progress) { steps_.push_back(progress); });
    }

    std::vector<double> steps_;
};

TEST_F(AnimationTest, RunsFromTheStartToExactlyOne) {
    const auto animation = start();
    EXPECT_TRUE(steps_.empty());
    EXPECT_TRUE(animation->isRunning());
    time->advance(0.25);
    EXPECT_GE(steps_.size(), 14u);
    EXPECT_GT(steps_.back(), 0.4);
    EXPECT_LT(steps_.back(), 1.0);
    time->advance(0.25);
    EXPECT_EQ(steps_.back(), 1.0);
    EXPECT_FALSE(animation->isRunning());
    EXPECT_TRUE(std::is_sorted(steps_.begin(), steps_.end()));
    const auto count = steps_.size();
    time->advance(1.0);
    EXPECT_EQ(steps_.size(), count);
    EXPECT_EQ(time->pendingTimers(), 0u);
}

TEST_F(AnimationTest, UntilIdle_IsAtItsEnd) {
    start();
    time->runUntilIdle(1.0);
    EXPECT_EQ(steps_.back(), 1.0);
}

TEST_F(AnimationTest, Stopped_StaysWhereItIs) {
    const auto animation = start();
    time->advance(0.2);
    const auto count = steps_.size();
    animation->stop();
    EXPECT_FALSE(animation->isRunning());
    time->advance(1.0);
    EXPECT_EQ(steps_.size(), count);
    EXPECT_EQ(time->pendingTimers(), 0u);
}

TEST_F(AnimationTest, NobodyHoldsIt_ItGoesOn) {
    start().reset();
    time->advance(0.5);
    EXPECT_EQ(steps_.back(), 1.0);
}

TEST_F(AnimationTest, StoppedByItsOwnStep) {
    std::shared_ptr<Animation> animation;
    animation = Animation::start(0.5, [&](double) {
        steps_.push_back(0.0);
        animation->stop();
    });
    time->advance(1.0);
    EXPECT_EQ(steps_.size(), 1u);
}

TEST_F(AnimationTest, ReducedMotion_IsThereAtOnce) {
    appearance->reducedMotion = true;
    EXPECT_FALSE(start()->isRunning());
    EXPECT_EQ(steps_, (std::vector<double>{1.0}));
}

TEST_F(AnimationTest, NoTime_IsThereAtOnce) {
    EXPECT_FALSE(start(0.0)->isRunning());
    EXPECT_EQ(steps_, (std::vector<double>{1.0}));
}

TEST_F(AnimationTest, TheBlockRunsAtOnceAndKnowsItsDuration) {
    EXPECT_EQ(Animation::currentDuration(), 0.0);
    double inside = 0.0;
    double nested = 0.0;
    double after = 0.0;
    Animation::animate(0.5, [&] {
        inside = Animation::currentDuration();
        Animation::animate(0.2, [&] { nested = Animation::currentDuration(); });
        after = Animation::currentDuration();
    });
    EXPECT_EQ(inside, 0.5);
    EXPECT_EQ(nested, 0.2);
    EXPECT_EQ(after, 0.5);
    EXPECT_EQ(Animation::currentDuration(), 0.0);
}

TEST_F(AnimationTest, Easing_IsTheCurve) {
    EXPECT_EQ(Animation::eased(0.0), 0.0);
    EXPECT_EQ(Animation::eased(1.0), 1.0);
    // Of the curve's own parameter 1/2: x = (3 * 0.4 + 3 * 0.2 + 1) / 8, y = (3 + 1) / 8.
    EXPECT_NEAR(Animation::eased(0.35), 0.5, 1e-6);
    EXPECT_LT(Animation::eased(0.1), 0.1);
    EXPECT_GT(Animation::eased(0.6), 0.8);
    EXPECT_EQ(Animation::eased(2.0), 1.0);
    EXPECT_EQ(Animation::eased(-1.0), 0.0);
}

}  // namespace ktr::test
