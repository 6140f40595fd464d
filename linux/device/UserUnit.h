#pragma once

#include <QDBusConnection>
#include <QDBusMessage>
#include <QObject>
#include <QString>
#include <functional>
#include <optional>
#include <utility>
#include <vector>

#include "linux/device/Aside.h"

namespace ktr::linux_ {

/// A service of the user's that systemd's manager of the user's services keeps running, now and from each start of the
/// session on (org.freedesktop.systemd1 on the session's bus). Nothing waits: the bus is joined in the background, and
/// a manager that does not answer counts as none. Main thread.
class UserUnit : public QObject {
  public:
    enum class State {
        Unknown,  ///< nobody has said it yet
        None,     ///< there is no such manager, or it has no such service, or may not start it
        Off,
        On,
    };
    /// What a call may take, milliseconds.
    static constexpr int kLongestSilence = 5000;

    /// `unit`: its name, such as "ktr-watch.service". `busAddress`: of the session's bus; empty: none.
    UserUnit(const QString& busAddress, QString unit);
    ~UserUnit() override;

    State state() const { return state_; }
    /// Called after the state has become another, and when a wish was not granted.
    void setChanged(std::function<void()> changed) { changed_ = std::move(changed); }
    /// Of a service that is on or off; another wish before the first is granted, or not, counts for nothing.
    void setOn(bool isOn);
    bool isBusy() const { return isBusy_; }

  private:
    using Then = std::function<void(const QDBusMessage& answer)>;

    void useBus(const QDBusConnection& bus);
    void call(const QString& method, const QVariantList& arguments, Then then);
    /// Each only if those before it were answered.
    void callAll(const std::vector<std::pair<QString, QVariantList>>& calls);
    void ask();
    void set(State state);

    const QString unit_;
    State state_ = State::Unknown;
    bool isBusy_ = false;
    std::function<void()> changed_;
    std::optional<QDBusConnection> bus_;
    Aside aside_;
};

}  // namespace ktr::linux_
