#include "linux/device/QtMainLoop.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <QEventLoop>
#include <atomic>
#include <chrono>
#include <latch>
#include <numeric>
#include <vector>

namespace ktr::linux_ {

TEST(QtMainLoopTest, BackgroundWork_RunsOnAnotherThread) {
    QtMainLoop loop;
    std::latch done(1);
    bool onMain = true;
    loop.runInBackground([&] {
        onMain = loop.isMainThread();
        done.count_down();
    });
    done.wait();
    EXPECT_FALSE(onMain);
}

TEST(QtMainLoopTest, TheEnd_WaitsForBackgroundWorkUnderWayAndDropsItsResult) {
    auto loop = std::make_unique<QtMainLoop>();
    std::latch started(1);
    std::latch goOn(1);
    std::atomic<bool> finished = false;
    std::atomic<bool> delivered = false;
    auto* raw = loop.get();
    loop->runInBackground([&, raw] {
        started.count_down();
        goOn.wait();
        raw->post([&] { delivered = true; });
        finished = true;
    });
    started.wait();
    goOn.count_down();
    loop.reset();
    EXPECT_TRUE(finished);
    QCoreApplication::processEvents();
    EXPECT_FALSE(delivered);
}

TEST(QtMainLoopTest, WorkThatPostsWhenItIsDropped_IsDroppedToo) {
    struct PostsAtTheEnd {
        QtMainLoop* loop;
        bool* ran;
        PostsAtTheEnd(QtMainLoop* on, bool* flag) : loop(on), ran(flag) {}
        ~PostsAtTheEnd() {
            loop->post([flag = ran] { *flag = true; });
        }
    };
    bool ran = false;
    auto loop = std::make_unique<QtMainLoop>();
    auto guard = std::make_shared<PostsAtTheEnd>(loop.get(), &ran);
    loop->post([guard = std::move(guard)] {});
    loop.reset();
    QCoreApplication::processEvents();
    EXPECT_FALSE(ran);
}

TEST(QtMainLoopTest, ManySteps_AreOneTimerOfTheToolkit_AndRunInTheirOrder) {
    class TimerEvents : public QObject {
      public:
        bool eventFilter(QObject*, QEvent* event) override {
            count += event->type() == QEvent::Timer ? 1 : 0;
            return false;
        }
        int count = 0;
    };
    constexpr int kSteps = 20000;
    QtMainLoop loop;
    TimerEvents events;
    QCoreApplication::instance()->installEventFilter(&events);
    std::vector<int> ran;
    for (int i = 0; i < kSteps; ++i) {
        loop.schedule(0.001, false, [&ran, i] { ran.push_back(i); });
    }
    std::vector<int> inOrder(kSteps);
    std::iota(inOrder.begin(), inOrder.end(), 0);
    while (ran.size() < inOrder.size()) {
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    EXPECT_EQ(ran, inOrder);
    EXPECT_LT(events.count, kSteps / 10);
}

TEST(QtMainLoopTest, WorkWithAnEventLoopOfItsOwn_HoldsUpNothingElse) {
    QtMainLoop loop;
    bool other = false;
    bool done = false;
    loop.schedule(0.001, false, [&] {
        while (!other) {
            QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
        }
        done = true;
    });
    loop.schedule(0.001, false, [&] { other = true; });
    while (!done) {
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    EXPECT_TRUE(other);
}

TEST(QtMainLoopTest, WhoStopsATimer_MayLiveByWhatItsWorkHolds) {
    struct Owner {
        std::shared_ptr<platform::Timer> timer;
        bool* gone = nullptr;
        ~Owner() { *gone = true; }
    };
    QtMainLoop loop;
    bool gone = false;
    auto owner = std::make_shared<Owner>();
    owner->gone = &gone;
    owner->timer = loop.schedule(1000.0, true, [owner] {});
    const auto* raw = owner.get();
    owner.reset();
    raw->timer->invalidate();
    EXPECT_FALSE(gone) << "inside its own call";
    while (!gone) {
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    EXPECT_TRUE(gone);
}

TEST(QtMainLoopTest, ALoopThatEndsInItsOwnWork_RunsNothingMore) {
    auto loop = std::make_unique<QtMainLoop>();
    bool ran = false;
    loop->schedule(0.0, false, [&loop] { loop.reset(); });
    const auto next = loop->schedule(0.0, true, [&ran] { ran = true; });
    while (loop) {
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    EXPECT_FALSE(next->isValid());
    QCoreApplication::processEvents();
    EXPECT_FALSE(ran);
}

TEST(QtMainLoopTest, ATimerNeverFiresEarly) {
    QtMainLoop loop;
    using Clock = std::chrono::steady_clock;
    const auto start = Clock::now();
    Clock::duration passed{};
    bool fired = false;
    loop.schedule(0.0105, false, [&] {
        passed = Clock::now() - start;
        fired = true;
    });
    while (!fired) {
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
    EXPECT_GE(passed, std::chrono::microseconds(10500));
}

TEST(QtMainLoopTest, AWaitBeyondTheTimersReach_IsKept) {
    QtMainLoop loop;
    bool fired = false;
    const auto timer = loop.schedule(1e12, false, [&] { fired = true; });
    QCoreApplication::processEvents();
    EXPECT_FALSE(fired);
    EXPECT_TRUE(timer->isValid());
    EXPECT_EQ(timer->interval(), 1e12);
}

TEST(QtMainLoopTest, ATimerOutlivingTheLoop_IsInvalid) {
    auto loop = std::make_unique<QtMainLoop>();
    const auto timer = loop->schedule(10.0, true, [] {});
    loop.reset();
    EXPECT_FALSE(timer->isValid());
    timer->invalidate();
}

}  // namespace ktr::linux_
