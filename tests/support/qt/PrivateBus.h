#pragma once

#include <gtest/gtest.h>

#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusVirtualObject>
#include <QProcess>
#include <QString>
#include <QTemporaryFile>
#include <functional>

#include "tests/support/qt/EventLoops.h"

namespace ktr::test {

/// A message bus of the test's own, which starts no service of this machine's.
class PrivateBus {
  public:
    PrivateBus() {
        EXPECT_TRUE(configuration_.open());
        configuration_.write(R"(<busconfig><type>session</type><listen>unix:tmpdir=/tmp</listen>
            <policy context="default"><allow send_destination="*"/><allow receive_sender="*"/><allow own="*"/></policy>
            </busconfig>)");
        configuration_.flush();
        daemon_.start(QStringLiteral("dbus-daemon"), {QStringLiteral("--config-file=") + configuration_.fileName(),
                                                      QStringLiteral("--nofork"), QStringLiteral("--print-address=1")});
        if (daemon_.waitForStarted(10000) && daemon_.waitForReadyRead(10000)) {
            address_ = QString::fromUtf8(daemon_.readLine()).trimmed();
        }
        EXPECT_FALSE(address_.isEmpty()) << "dbus-daemon does not start";
    }
    ~PrivateBus() { die(); }
    PrivateBus(const PrivateBus&) = delete;
    PrivateBus& operator=(const PrivateBus&) = delete;

    /// A connection of its own; names are used once.
    QDBusConnection connect(const QString& name) const { return QDBusConnection::connectToBus(address_, name); }
    const QString& address() const { return address_; }
    /// Leaves everybody who is connected without a word.
    void die() {
        daemon_.kill();
        daemon_.waitForFinished();
    }
    static void disconnect(const QString& name) { QDBusConnection::disconnectFromBus(name); }

  private:
    QTemporaryFile configuration_;
    QProcess daemon_;
    QString address_;
};

/// A service whose objects all answer through one function; what that leaves unanswered is an error to the caller.
class FakeService : public QDBusVirtualObject {
  public:
    using Answer = std::function<bool(const QDBusMessage&, const QDBusConnection&)>;
    explicit FakeService(Answer answer) : answer_(std::move(answer)) {}
    QString introspect(const QString&) const override { return {}; }
    bool handleMessage(const QDBusMessage& message, const QDBusConnection& connection) override {
        return answer_(message, connection);
    }

  private:
    Answer answer_;
};

}  // namespace ktr::test
