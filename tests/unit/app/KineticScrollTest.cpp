#include "app/window/KineticScroll.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

TEST(KTRKineticScrollTest, Drag_FollowsTheFinger) {
    KineticScroll scroll;
    scroll.press(100.0, 0.0);
    EXPECT_EQ(scroll.drag(90.0, 0.01), 10.0);
    EXPECT_EQ(scroll.drag(95.0, 0.02), -5.0);
}

TEST(KTRKineticScrollTest, Fling_SlowsDownAndStands) {
    KineticScroll scroll;
    scroll.press(500.0, 0.0);
    for (int i = 1; i <= 5; ++i) {
        scroll.drag(500.0 - 10.0 * i, 0.01 * i);
    }
    scroll.release(0.05);
    ASSERT_TRUE(scroll.isFlinging());
    double last = 1e9;
    double total = 0.0;
    double time = 0.05;
    while (scroll.isFlinging()) {
        time += 0.016;
        ASSERT_LT(time, 10.0);
        const double moved = scroll.step(time);
        EXPECT_GT(moved, 0.0);
        EXPECT_LT(moved, last);
        last = moved;
        total += moved;
    }
    // 1000 points a second, times the time constant, less what the slowest speed leaves.
    EXPECT_NEAR(total, 1000.0 * KineticScroll::kTimeConstant, KineticScroll::kSlowest);
}

TEST(KTRKineticScrollTest, FingerThatRests_LeavesNoFling) {
    KineticScroll scroll;
    scroll.press(100.0, 0.0);
    scroll.drag(50.0, 0.02);
    scroll.release(1.0);
    EXPECT_FALSE(scroll.isFlinging());
    EXPECT_EQ(scroll.step(2.0), 0.0);
}

TEST(KTRKineticScrollTest, Press_StopsAFling) {
    KineticScroll scroll;
    scroll.press(100.0, 0.0);
    scroll.drag(50.0, 0.02);
    scroll.release(0.02);
    ASSERT_TRUE(scroll.isFlinging());
    scroll.press(10.0, 0.1);
    EXPECT_FALSE(scroll.isFlinging());
}

}  // namespace

}  // namespace ktr::app
