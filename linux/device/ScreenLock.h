#pragma once

#include <QDBusConnection>
#include <QObject>
#include <functional>
#include <utility>

#include "linux/device/LogindLock.h"

namespace ktr::linux_ {

/// Whether anybody but the user may be looking: logind's lock, and the session's screen saver where there is one
/// (org.freedesktop.ScreenSaver: GetActive, ActiveChanged). For a program that the bus may start on a locked desktop:
/// until both have answered, or are not there, it counts as locked. No screen saver is started for it. Main thread.
class ScreenLock : public QObject {
    Q_OBJECT

  public:
    ScreenLock(const QDBusConnection& session, const QDBusConnection& system);

    bool isKnown() const { return lock_.isKnown() && isSaverKnown_; }
    bool isOpen() const;
    /// Called after either of them may have become another.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }

  private Q_SLOTS:
    void activeChanged(bool isActive);

  private:
    void askSaver();
    void tellChanged() const;

    QDBusConnection session_;
    LogindLock lock_;
    bool isSaverKnown_ = false;
    bool isSaverActive_ = false;
    std::function<void()> changed_;
};

}  // namespace ktr::linux_
