#pragma once

#include <QDBusConnection>
#include <QObject>
#include <QString>
#include <QStringList>
#include <QVariantMap>

#include "platform/base/DeviceInformation.h"

class QDBusPendingCallWatcher;

namespace ktr::linux_ {

/// The lock state of this login session, from logind (org.freedesktop.login1, property LockedHint). It asks once and
/// then listens; until the answer comes, and without a bus, a session or logind, the device counts as one without a
/// lock. Follows logind when it restarts. Main thread.
class LogindLock : public QObject, public platform::DeviceLock {
    Q_OBJECT

  public:
    /// The bus: the system's, but for tests.
    explicit LogindLock(QDBusConnection bus = QDBusConnection::systemBus());
    ~LogindLock() override;

    int lockState() const override { return state_; }

  private Q_SLOTS:
    void propertiesChanged(const QString& interface, const QVariantMap& changed, const QStringList& invalidated);

  private:
    void findSession();
    void findSessionOfUser();
    void useSession(const QString& path);
    void readHint();
    void setHint(bool locked) { state_ = locked ? kLocked : kUnlocked; }

    QDBusConnection bus_;
    QString session_;
    int state_ = kWithoutLock;
};

}  // namespace ktr::linux_
