#include "app/window/DragTrail.h"

#include <gtest/gtest.h>

namespace ktr::app {

TEST(KTRDragTrailTest, Move_TellsTheWaySinceTheLastOne) {
    DragTrail trail;
    EXPECT_EQ(trail.move({5.0, 5.0}, 0.0), QPointF()) << "it takes hold";
    EXPECT_EQ(trail.move({8.0, 4.0}, 0.01), QPointF(3.0, -1.0));
    trail.begin({0.0, 0.0}, 0.02);
    EXPECT_EQ(trail.move({1.0, 1.0}, 0.03), QPointF(1.0, 1.0));
}

TEST(KTRDragTrailTest, Release_TellsTheSpeedOfTheLastMoments) {
    DragTrail trail;
    trail.begin({0.0, 0.0}, 0.0);
    // A long way, slowly, and then 10 across and 20 down in each hundredth of a second.
    trail.move({500.0, 0.0}, 10.0);
    for (int i = 1; i <= 20; ++i) {
        trail.move({500.0 + 10.0 * i, 20.0 * i}, 10.0 + 0.01 * i);
    }
    const QPointF speed = trail.release(10.2);
    EXPECT_NEAR(speed.x(), 1000.0, 1e-6);
    EXPECT_NEAR(speed.y(), 2000.0, 1e-6);
    EXPECT_TRUE(trail.isEmpty());
    EXPECT_EQ(trail.release(10.2), QPointF()) << "it has let go already";
}

TEST(KTRDragTrailTest, AHandThatRests_LeavesNoSpeed) {
    DragTrail trail;
    trail.begin({0.0, 0.0}, 0.0);
    trail.move({50.0, 0.0}, 0.02);
    EXPECT_EQ(trail.release(0.02 + 2.0 * DragTrail::kMemory), QPointF());
    trail.begin({0.0, 0.0}, 1.0);
    EXPECT_EQ(trail.release(1.0), QPointF()) << "a press is no drag";
}

}  // namespace ktr::app
