#pragma once

#include <QDBusConnection>
#include <QFileSystemWatcher>
#include <QObject>
#include <QSocketNotifier>
#include <QString>
#include <QTimer>
#include <functional>
#include <memory>

namespace ktr::linux_ {

/// Tells when time did not simply run on: the computer has slept (logind's PrepareForSleep), its clock was set, or it
/// has another zone. Without a bus or such a file that part is never told. Main thread.
class TimeJumps : public QObject {
    Q_OBJECT

  public:
    /// The bus: the system's, but for tests. `zone`: the file that is the zone.
    explicit TimeJumps(QDBusConnection bus = QDBusConnection::systemBus(),
                       const QString& zone = QStringLiteral("/etc/localtime"));
    ~TimeJumps() override;

    /// Called once after each jump, soon.
    void setJumped(std::function<void()> jumped) { jumped_ = std::move(jumped); }

  private Q_SLOTS:
    void prepareForSleep(bool goes);

  private:
    void watchClock();
    /// Asks the system to say when the clock is set.
    void armClock() const;
    void watchZone(const QString& zone);

    QDBusConnection bus_;
    int clock_ = -1;
    std::unique_ptr<QSocketNotifier> clockSet_;
    QFileSystemWatcher zone_;
    /// What comes together is told once.
    QTimer soon_;
    std::function<void()> jumped_;
};

}  // namespace ktr::linux_
