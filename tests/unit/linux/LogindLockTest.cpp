#include "linux/device/LogindLock.h"

#include <QCoreApplication>
#include <QDBusConnectionInterface>
#include <QDBusObjectPath>
#include <QDBusVariant>
#include <memory>

#include "tests/support/qt/PrivateBus.h"

namespace ktr::test {

using linux_::LogindLock;

class LogindLockTest : public ::testing::Test {
  protected:
    LogindLockTest() : service(bus.connect(QStringLiteral("logind"))), client(bus.connect(QStringLiteral("program"))) {}
    ~LogindLockTest() override {
        PrivateBus::disconnect(QStringLiteral("logind"));
        PrivateBus::disconnect(QStringLiteral("program"));
    }

    void startLogind() {
        fake = std::make_unique<FakeService>([this](const QDBusMessage& message, const QDBusConnection& connection) {
            if (message.member() == QLatin1String("GetSessionByPID")) {
                return connection.send(message.createReply(QVariant::fromValue(QDBusObjectPath(kSession))));
            }
            if (message.member() == QLatin1String("Get") && message.path() == kSession) {
                ++reads;
                return connection.send(message.createReply(QVariant::fromValue(QDBusVariant(locked))));
            }
            return false;
        });
        ASSERT_TRUE(service.registerVirtualObject(QStringLiteral("/org/freedesktop/login1"), fake.get(),
                                                  QDBusConnection::SubPath));
        ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.login1")));
    }
    void announce(bool now) {
        locked = now;
        QDBusMessage signal = QDBusMessage::createSignal(kSession, QStringLiteral("org.freedesktop.DBus.Properties"),
                                                         QStringLiteral("PropertiesChanged"));
        signal << QStringLiteral("org.freedesktop.login1.Session") << QVariantMap{{QStringLiteral("LockedHint"), now}}
               << QStringList();
        ASSERT_TRUE(service.send(signal));
    }

    const QString kSession = QStringLiteral("/org/freedesktop/login1/session/_31");
    PrivateBus bus;
    QDBusConnection service, client;
    std::unique_ptr<FakeService> fake;
    bool locked = false;
    int reads = 0;
};

TEST_F(LogindLockTest, NoBus_CountsAsWithoutLock) {
    EXPECT_EQ(LogindLock(QDBusConnection(QStringLiteral("none"))).lockState(), LogindLock::kWithoutLock);
}

TEST_F(LogindLockTest, Hint_IsReadAndFollowed) {
    locked = true;
    startLogind();
    const LogindLock lock(client);
    EXPECT_EQ(lock.lockState(), LogindLock::kWithoutLock) << "it does not wait for the bus";
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kLocked; }));
    announce(false);
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kUnlocked; }));
    announce(true);
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kLocked; }));
}

TEST_F(LogindLockTest, LogindThatComesAndGoes_IsFollowed) {
    const LogindLock lock(client);
    startLogind();
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kUnlocked; }));
    ASSERT_TRUE(service.unregisterService(QStringLiteral("org.freedesktop.login1")));
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kWithoutLock; }));
    locked = true;
    ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.login1")));
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kLocked; }));
}

// Whoever restarts or kills logind on a locked screen must not make it speak of friends.
TEST_F(LogindLockTest, LogindThatGoesFromALockedScreen_LeavesItLocked) {
    LogindLock lock(client);
    locked = true;
    startLogind();
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kLocked; }));
    int changes = 0;
    lock.setChanged([&changes] { ++changes; });
    ASSERT_TRUE(service.unregisterService(QStringLiteral("org.freedesktop.login1")));
    // What the bus says of it has come before the bus's answer to this.
    EXPECT_FALSE(client.interface()->isServiceRegistered(QStringLiteral("org.freedesktop.login1")));
    QCoreApplication::processEvents();
    EXPECT_EQ(lock.lockState(), LogindLock::kLocked);
    const int before = reads;
    ASSERT_TRUE(service.registerService(QStringLiteral("org.freedesktop.login1")));
    EXPECT_TRUE(eventually([&] { return reads > before; }));
    EXPECT_EQ(lock.lockState(), LogindLock::kLocked);
    EXPECT_EQ(changes, 0);
    announce(false);
    EXPECT_TRUE(eventually([&] { return lock.lockState() == LogindLock::kUnlocked; }));
}

TEST_F(LogindLockTest, Change_IsToldOnceAfterIt) {
    startLogind();
    LogindLock lock(client);
    std::vector<int> told;
    lock.setChanged([&] { told.push_back(lock.lockState()); });
    EXPECT_TRUE(eventually([&] { return told.size() == 1; }));
    announce(false);
    announce(true);
    EXPECT_TRUE(eventually([&] { return told.size() == 2; }));
    EXPECT_EQ(told, (std::vector<int>{LogindLock::kUnlocked, LogindLock::kLocked}));
}

}  // namespace ktr::test
