#include "platform/base/VirtualTime.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>
#include <thread>
#include <vector>

namespace ktr::test {
namespace {

using platform::Date;
using platform::VirtualTime;

class VirtualTimeTest : public ::testing::Test {
  protected:
    platform::MainLoop::Work note(std::string name) {
        return [this, name = std::move(name)] {
            events.push_back(name + "@" + std::to_string(static_cast<int>(time.now().secondsSinceReferenceDate)));
        };
    }
    VirtualTime time{Date{100.0}};
    std::vector<std::string> events;
};

using Events = std::vector<std::string>;

TEST_F(VirtualTimeTest, TheClockMovesOnlyWhenTold) {
    EXPECT_EQ(time.now(), Date{100.0});
    time.runPosted();
    EXPECT_EQ(time.now(), Date{100.0});
    time.advance(2.5);
    EXPECT_EQ(time.now(), Date{102.5});
}

TEST_F(VirtualTimeTest, PostedWorkRunsLaterInOrder) {
    time.post(note("a"));
    time.post([this] {
        note("b")();
        time.post(note("d"));
    });
    time.post(note("c"));
    EXPECT_TRUE(events.empty());
    time.runPosted();
    EXPECT_EQ(events, (Events{"a@100", "b@100", "c@100", "d@100"}));
}

TEST_F(VirtualTimeTest, WorkThatPostsItselfForEverIsCutOff) {
    int turns = 0;
    std::function<void()> again = [&] {
        ++turns;
        time.post(again);
    };
    time.post(again);
    time.runPosted(10);
    EXPECT_EQ(turns, 10);
}

TEST_F(VirtualTimeTest, TimersFireAtTheirOwnTime) {
    time.schedule(3.0, false, note("late"));
    time.schedule(1.0, false, note("early"));
    time.schedule(1.0, false, note("early too"));
    time.advance(0.5);
    EXPECT_TRUE(events.empty());
    time.advance(10.0);
    EXPECT_EQ(events, (Events{"early@101", "early too@101", "late@103"}));
    EXPECT_EQ(time.now(), Date{110.5});
}

TEST_F(VirtualTimeTest, ATimerOfNoTimeFiresOnTheNextTurnNotInsideTheCall) {
    time.schedule(0.0, false, note("zero"));
    time.schedule(-5.0, false, note("negative"));
    EXPECT_TRUE(events.empty());
    time.advance(0.0);
    EXPECT_EQ(events, (Events{"zero@100", "negative@100"}));
}

TEST_F(VirtualTimeTest, AnInvalidatedTimerDoesNotFire) {
    const auto timer = time.schedule(1.0, false, note("never"));
    EXPECT_TRUE(timer->isValid());
    timer->invalidate();
    timer->invalidate();
    EXPECT_FALSE(timer->isValid());
    time.advance(5.0);
    EXPECT_TRUE(events.empty());
    EXPECT_EQ(time.pendingTimers(), 0U);
}

TEST_F(VirtualTimeTest, DroppingTheHandleDoesNotStopATimer) {
    time.schedule(1.0, false, note("still")).reset();
    time.advance(1.0);
    EXPECT_EQ(events, Events{"still@101"});
}

TEST_F(VirtualTimeTest, AOneShotTimerIsInvalidOnceItHasFired) {
    const auto timer = time.schedule(1.0, false, note("once"));
    EXPECT_EQ(timer->interval(), 1.0);
    time.advance(1.0);
    EXPECT_FALSE(timer->isValid());
}

TEST_F(VirtualTimeTest, ARepeatingTimerFiresUntilItIsInvalidated) {
    const auto timer = time.schedule(30.0, true, note("tick"));
    time.advance(65.0);
    timer->invalidate();
    time.advance(65.0);
    EXPECT_EQ(events, (Events{"tick@130", "tick@160"}));
}

TEST_F(VirtualTimeTest, ARepeatingTimerMayInvalidateItself) {
    std::shared_ptr<platform::Timer> timer;
    timer = time.schedule(1.0, true, [&] {
        note("tick")();
        timer->invalidate();
    });
    time.advance(5.0);
    EXPECT_EQ(events, Events{"tick@101"});
}

TEST_F(VirtualTimeTest, ARepeatingTimerOfNoTimeStillLetsTimePass) {
    int ticks = 0;
    const auto timer = time.schedule(0.0, true, [&] { ++ticks; });
    time.advance(0.0105);
    EXPECT_EQ(ticks, 10);
    EXPECT_EQ(timer->interval(), 0.001);
}

TEST_F(VirtualTimeTest, PostedWorkRunsBetweenTimersOfOneAdvance) {
    time.schedule(1.0, false, [this] { time.post(note("posted")); });
    time.schedule(2.0, false, note("second"));
    time.advance(3.0);
    EXPECT_EQ(events, (Events{"posted@101", "second@102"}));
}

TEST_F(VirtualTimeTest, RunUntilIdleFollowsChainsOfTimersWithinTheHorizon) {
    time.schedule(0.1, false, [this] { time.schedule(2.0, false, note("chained")); });
    time.schedule(3600.0, false, note("too far"));
    time.schedule(0.5, true, note("tick"));
    const double passed = time.runUntilIdle(10.0);
    EXPECT_NEAR(passed, 2.1, 1e-9);
    EXPECT_EQ(events.back(), "chained@102");
    EXPECT_EQ(time.pendingTimers(), 2U) << "the far one and the repeating one";
}

TEST_F(VirtualTimeTest, BackgroundWorkIsATurnOfTheMainThread) {
    bool onMain = false;
    time.runInBackground([&] { onMain = time.isMainThread(); });
    EXPECT_FALSE(onMain);
    time.runPosted();
    EXPECT_TRUE(onMain);
}

TEST_F(VirtualTimeTest, OtherThreadsMayPost) {
    bool onMain = true;
    std::thread other([&] {
        onMain = time.isMainThread();
        time.post(note("from another thread"));
    });
    other.join();
    EXPECT_FALSE(onMain);
    time.runPosted();
    EXPECT_EQ(events, Events{"from another thread@100"});
}

}  // namespace
}  // namespace ktr::test
