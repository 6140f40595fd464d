#include "tests/contract/MainLoopContract.h"

#include <thread>
#include <vector>

#include "platform/base/VirtualTime.h"

namespace ktr::test {

using platform::Timer;

TEST_P(MainLoopContract, Post_RunsLaterInTheOrderOfPosting) {
    std::vector<int> ran;
    for (int i = 0; i < 5; ++i) {
        subject.loop->post([&ran, i] { ran.push_back(i); });
    }
    EXPECT_TRUE(ran.empty());
    ASSERT_TRUE(run([&] { return ran.size() == 5; }));
    EXPECT_EQ(ran, (std::vector{0, 1, 2, 3, 4}));
}

TEST_P(MainLoopContract, PostInsideWork_RunsOnALaterTurn) {
    std::vector<std::string> order;
    subject.loop->post([&] {
        subject.loop->post([&] { order.emplace_back("inner"); });
        order.emplace_back("outer");
    });
    ASSERT_TRUE(run([&] { return order.size() == 2; }));
    EXPECT_EQ(order, (std::vector<std::string>{"outer", "inner"}));
}

TEST_P(MainLoopContract, PostFromAnotherThread_RunsOnTheMainThread) {
    bool onMain = false;
    bool ran = false;
    std::thread([&] {
        EXPECT_FALSE(subject.loop->isMainThread());
        subject.loop->post([&] {
            onMain = subject.loop->isMainThread();
            ran = true;
        });
    }).join();
    ASSERT_TRUE(run([&] { return ran; }));
    EXPECT_TRUE(onMain);
}

TEST_P(MainLoopContract, ThisThreadIsTheMainThread) {
    EXPECT_TRUE(subject.loop->isMainThread());
}

TEST_P(MainLoopContract, OneShotTimer_FiresOnceAndIsInvalidThen) {
    int fired = 0;
    bool validInside = true;
    std::shared_ptr<Timer> timer;
    timer = subject.loop->schedule(0.005, false, [&] {
        ++fired;
        validInside = timer->isValid();
    });
    EXPECT_TRUE(timer->isValid());
    EXPECT_DOUBLE_EQ(timer->interval(), 0.005);
    EXPECT_EQ(fired, 0);
    ASSERT_TRUE(run([&] { return fired == 1; }));
    runTurns();
    EXPECT_EQ(fired, 1);
    EXPECT_FALSE(validInside);
    EXPECT_FALSE(timer->isValid());
}

TEST_P(MainLoopContract, ZeroOrNegativeDelay_FiresOnTheNextTurnNeverInsideTheCall) {
    int fired = 0;
    subject.loop->schedule(0.0, false, [&] { ++fired; });
    subject.loop->schedule(-3.0, false, [&] { ++fired; });
    EXPECT_EQ(fired, 0);
    EXPECT_TRUE(run([&] { return fired == 2; }));
}

TEST_P(MainLoopContract, DroppingTheHandle_DoesNotStopTheTimer) {
    bool fired = false;
    subject.loop->schedule(0.005, false, [&] { fired = true; });
    EXPECT_TRUE(run([&] { return fired; }));
}

TEST_P(MainLoopContract, RepeatingTimer_FiresUntilItIsInvalidated) {
    int fired = 0;
    std::shared_ptr<Timer> timer;
    timer = subject.loop->schedule(0.002, true, [&] {
        if (++fired == 3) {
            timer->invalidate();
        }
    });
    ASSERT_TRUE(run([&] { return fired == 3; }));
    EXPECT_FALSE(timer->isValid());
    runTurns();
    EXPECT_EQ(fired, 3);
}

TEST_P(MainLoopContract, RepeatingTimerOfNoInterval_RepeatsAtLeastAMillisecondApart) {
    int fired = 0;
    const auto timer = subject.loop->schedule(0.0, true, [&] { ++fired; });
    EXPECT_GE(timer->interval(), 0.001);
    EXPECT_TRUE(run([&] { return fired >= 3; }));
    timer->invalidate();
}

TEST_P(MainLoopContract, InvalidatedTimer_NeverFires) {
    bool fired = false;
    const auto timer = subject.loop->schedule(0.001, false, [&] { fired = true; });
    timer->invalidate();
    timer->invalidate();
    EXPECT_FALSE(timer->isValid());
    runTurns();
    EXPECT_FALSE(fired);
}

TEST_P(MainLoopContract, ATimerMayStopAnotherThatIsDueAtTheSameTime) {
    bool second = false;
    std::shared_ptr<Timer> victim;
    subject.loop->schedule(0.004, false, [&] { victim->invalidate(); });
    victim = subject.loop->schedule(0.004, false, [&] { second = true; });
    ASSERT_TRUE(run([&] { return !victim->isValid(); }));
    runTurns();
    EXPECT_FALSE(second);
}

TEST_P(MainLoopContract, ShorterTimersFireFirst) {
    std::vector<int> order;
    subject.loop->schedule(0.030, false, [&] { order.push_back(2); });
    subject.loop->schedule(0.005, false, [&] { order.push_back(1); });
    ASSERT_TRUE(run([&] { return order.size() == 2; }));
    EXPECT_EQ(order, (std::vector{1, 2}));
}

TEST_P(MainLoopContract, BackgroundWork_PostsItsResultBack) {
    int result = 0;
    subject.loop->runInBackground([loop = subject.loop, &result] { loop->post([&result] { result = 42; }); });
    EXPECT_EQ(result, 0);
    ASSERT_TRUE(run([&] { return result == 42; }));
}

TEST_P(MainLoopContract, WorkLeftAtTheEnd_IsDroppedWithWhatItHolds) {
    bool ran = false;
    const auto held = std::make_shared<int>(1);
    subject.loop->post([held, &ran] { ran = true; });
    subject.loop->schedule(0.0, false, [held, &ran] { ran = true; });
    const auto timer = subject.loop->schedule(1000.0, true, [held, &ran] { ran = true; });
    EXPECT_GT(held.use_count(), 1);
    subject = {};
    EXPECT_EQ(held.use_count(), 1);
    EXPECT_FALSE(ran);
    timer->invalidate();
}

INSTANTIATE_TEST_SUITE_P(VirtualTime, MainLoopContract,
                         ::testing::Values(MainLoopCase{
                             "VirtualTime",
                             [] {
                                 auto time = std::make_shared<platform::VirtualTime>(platform::Date{0.0});
                                 return MainLoopUnderTest{
                                     time, [time = time.get()](const std::function<bool()>& condition, double seconds) {
                                         for (double passed = 0.0; passed < seconds; passed += 0.001) {
                                             time->advance(0.001);
                                             if (condition()) {
                                                 return true;
                                             }
                                         }
                                         return condition();
                                     }};
                             }}),
                         caseName);

}  // namespace ktr::test
