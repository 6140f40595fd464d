#include "linux/device/TimeJumps.h"

#include <filesystem>

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

TEST_F(TimeJumpsTest, NoBusAndNoFile_IsNothingToTell) {
    TimeJumps none(QDBusConnection(QStringLiteral("none")), QStringLiteral("/nowhere/localtime"));
    bool isTold = false;
    none.setJumped([&] { isTold = true; });
    pass(300);
    EXPECT_FALSE(isTold);
}

}  // namespace ktr::test
