#pragma once

#include <QDBusConnection>
#include <QObject>
#include <QString>
#include <QStringList>
#include <QVariantMap>
#include <functional>
#include <utility>

#include "platform/base/DeviceInformation.h"

class QDBusPendingCallWatcher;

namespace ktr::linux_ {

/// The lock state of this login session, from logind (org.freedesktop.login1, property LockedHint). It asks once and
/// then listens; until the answer comes, and without a bus, a session or logind, the device counts as one without a
/// lock. Follows logind when it restarts; while it is gone, what was locked stays so. Main thread.
class LogindLock : public QObject, public platform::DeviceLock {
    Q_OBJECT

  public:
    /// The bus: the system's, but for tests.
    explicit LogindLock(QDBusConnection bus = QDBusConnection::systemBus());
    ~LogindLock() override;

    int lockState() const override { return state_; }
    /// Called after the state has become another.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }
    /// Whether logind has answered, or there is none: before that nobody can tell.
    bool isKnown() const { return isKnown_; }
    /// Called once, when that has become so; not when it is so already.
    void setKnown(std::function<void()> known) { known_ = std::move(known); }

  private Q_SLOTS:
    void propertiesChanged(const QString& interface, const QVariantMap& changed, const QStringList& invalidated);

  private:
    void findSession();
    void findSessionOfUser();
    void useSession(const QString& path);
    void readHint();
    void setState(int state);
    void setIsKnown();
    void setHint(bool locked) { setState(locked ? kLocked : kUnlocked); }

    QDBusConnection bus_;
    QString session_;
    int state_ = kWithoutLock;
    bool isKnown_ = false;
    std::function<void()> changed_;
    std::function<void()> known_;
};

}  // namespace ktr::linux_
