#include "linux/device/ScreenLock.h"

#include <QDBusObjectPath>
#include <QDBusVariant>
#include <memory>

#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::ScreenLock;

class ScreenLockTest : public ::testing::Test {
  protected:
    ScreenLockTest()
        : service(bus.connect(QStringLiteral("services"))), client(bus.connect(QStringLiteral("program"))) {}
    ~ScreenLockTest() override {
        PrivateBus::disconnect(QStringLiteral("services"));
        PrivateBus::disconnect(QStringLiteral("program"));
    }

    /// `answers` false: it keeps who asks waiting.
    void startLogind(bool answers) {
        logind = std::make_unique<FakeService>(
            [this, answers](const QDBusMessage& message, const QDBusConnection& connection) {
                message.setDelayedReply(true);
                if (!answers) {
                    return true;
                }
                if (message.member() == QLatin1String("GetSessionByPID")) {
                    return connection.send(message.createReply(QVariant::fromValue(QDBusObjectPath(kSession))));
                }
                return connection.send(message.createReply(QVariant::fromValue(QDBusVariant(isLocked))));
            });
        ASSERT_TRUE(service.registerVirtualObject(QStringLiteral("/org/freedesktop/login1"), logind.get(),
                                                  QDBusConnection::SubPath));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.login1")));
    }
    void startSaver() {
        saver = std::make_unique<FakeService>([this](const QDBusMessage& message, const QDBusConnection& connection) {
            return message.member() == QLatin1String("GetActive") && connection.send(message.createReply(isActive));
        });
        ASSERT_TRUE(service.registerVirtualObject(kSaverPath, saver.get()));
        ASSERT_TRUE(service.registerService(kSaver));
    }
    void announce(bool active) {
        isActive = active;
        QDBusMessage signal = QDBusMessage::createSignal(kSaverPath, kSaver, QStringLiteral("ActiveChanged"));
        signal << active;
        ASSERT_TRUE(service.send(signal));
    }

    const QString kSession = QStringLiteral("/org/freedesktop/login1/session/_31");
    const QString kSaver = QStringLiteral("org.freedesktop.ScreenSaver");
    const QString kSaverPath = QStringLiteral("/org/freedesktop/ScreenSaver");
    PrivateBus bus;
    QDBusConnection service, client;
    std::unique_ptr<FakeService> logind, saver;
    bool isLocked = false;
    bool isActive = false;
};

TEST_F(ScreenLockTest, UntilItIsKnown_CountsAsLocked) {
    startLogind(false);
    const ScreenLock lock(client, client);
    EXPECT_FALSE(lock.isOpen());
    wakesIn(300);
    EXPECT_FALSE(lock.isKnown() || lock.isOpen());
}

TEST_F(ScreenLockTest, NobodyWhoLocks_IsOpen) {
    int changes = 0;
    ScreenLock lock(client, client);
    lock.setChanged([&] { ++changes; });
    EXPECT_TRUE(eventually([&] { return lock.isKnown(); }));
    EXPECT_TRUE(lock.isOpen());
    EXPECT_GT(changes, 0) << "whoever waits hears of it";
}

TEST_F(ScreenLockTest, LockedSession_IsClosed) {
    isLocked = true;
    startLogind(true);
    const ScreenLock lock(client, client);
    EXPECT_TRUE(eventually([&] { return lock.isKnown(); }));
    EXPECT_FALSE(lock.isOpen());
}

TEST_F(ScreenLockTest, ScreenSaver_IsReadAndFollowed) {
    isActive = true;
    startLogind(true);
    startSaver();
    const ScreenLock lock(client, client);
    EXPECT_TRUE(eventually([&] { return lock.isKnown(); }));
    EXPECT_FALSE(lock.isOpen());
    announce(false);
    EXPECT_TRUE(eventually([&] { return lock.isOpen(); }));
    announce(true);
    EXPECT_TRUE(eventually([&] { return !lock.isOpen(); }));
    ASSERT_TRUE(service.unregisterService(kSaver));
    EXPECT_TRUE(eventually([&] { return lock.isOpen(); })) << "one that went covers nothing";
}

}  // namespace ktr::test
