#include "linux/device/TimeJumps.h"

#include <sys/timerfd.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

#include "tests/support/TemporaryFolder.h"
#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::TimeJumps;

class TimeJumpsTest : public ::testing::Test {
  protected:
    TimeJumpsTest() : service(bus.connect(QStringLiteral("logind"))), client(bus.connect(QStringLiteral("program"))) {
        std::filesystem::create_symlink("/usr/share/zoneinfo/Europe/Berlin", zone);
        jumps = std::make_unique<TimeJumps>(client, QString::fromStdString(zone.string()));
        jumps->setJumped([this] { ++told; });
    }
    ~TimeJumpsTest() override {
        jumps.reset();
        PrivateBus::disconnect(QStringLiteral("logind"));
        PrivateBus::disconnect(QStringLiteral("program"));
    }
    void sleep(bool goes) {
        QDBusMessage signal = QDBusMessage::createSignal(QStringLiteral("/org/freedesktop/login1"),
                                                         QStringLiteral("org.freedesktop.login1.Manager"),
                                                         QStringLiteral("PrepareForSleep"));
        signal << goes;
        ASSERT_TRUE(service.send(signal));
    }
    static void pass(int milliseconds) {
        const QDeadlineTimer deadline(milliseconds);
        while (!deadline.hasExpired()) {
            QCoreApplication::processEvents(QEventLoop::AllEvents | QEventLoop::WaitForMoreEvents, 20);
        }
    }
    /// The descriptor that becomes ready when the clock is set (proc(5), /proc/pid/fdinfo); -1: none.
    static int watchedClock() {
        for (const auto& entry : std::filesystem::directory_iterator("/proc/self/fdinfo")) {
            std::ifstream facts(entry.path());
            const std::string text{std::istreambuf_iterator<char>(facts), {}};
            if (text.find("clockid: 0\n") != std::string::npos &&
                text.find("settime flags: 03\n") != std::string::npos) {
                return std::stoi(entry.path().filename().string());
            }
        }
        return -1;
    }
    TemporaryFolder folder;
    const std::filesystem::path zone = folder.path() / "localtime";
    PrivateBus bus;
    QDBusConnection service, client;
    int told = 0;
    std::unique_ptr<TimeJumps> jumps;
};

TEST_F(TimeJumpsTest, Waking_IsToldOnce_AndGoingToSleepIsNot) {
    ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.login1")));
    sleep(true);
    pass(400);
    EXPECT_EQ(told, 0);
    sleep(false);
    EXPECT_TRUE(eventually([&] { return told == 1; }));
    pass(400);
    EXPECT_EQ(told, 1);
}

TEST_F(TimeJumpsTest, AnotherZone_IsTold_AndAnotherFileBesideItIsNot) {
    std::filesystem::create_symlink("/nowhere", folder.path() / "other");
    pass(500);
    EXPECT_EQ(told, 0);
    const auto beside = folder.path() / "new";
    std::filesystem::create_symlink("/usr/share/zoneinfo/Asia/Tokyo", beside);
    std::filesystem::rename(beside, zone);
    EXPECT_TRUE(eventually([&] { return told == 1; }));
}

/// A clock cannot be set here without setting it for everybody: what the system was asked is read instead, and the
/// descriptor is made to say what it says then.
TEST_F(TimeJumpsTest, ClockThatIsSet_IsToldEachTime) {
    const int clock = watchedClock();
    ASSERT_GE(clock, 0) << "nobody asks to hear of it";
    for (int time = 1; time <= 2; ++time) {
        itimerspec now{};
        now.it_value.tv_nsec = 1;
        ASSERT_EQ(::timerfd_settime(clock, TFD_TIMER_ABSTIME, &now, nullptr), 0);
        EXPECT_TRUE(eventually([&] { return told == time; }));
        EXPECT_EQ(watchedClock(), clock) << "it is asked for anew";
        pass(400);
        EXPECT_EQ(told, time) << "once";
    }
}

TEST_F(TimeJumpsTest, NoBusAndNoFile_IsNothingToTell) {
    TimeJumps none(QDBusConnection(QStringLiteral("none")), QStringLiteral("/nowhere/localtime"));
    bool isTold = false;
    none.setJumped([&] { isTold = true; });
    pass(300);
    EXPECT_FALSE(isTold);
}

}  // namespace ktr::test
