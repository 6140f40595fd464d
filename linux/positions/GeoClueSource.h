#pragma once

#include <QDBusConnection>
#include <QDBusObjectPath>
#include <QObject>
#include <QString>
#include <memory>

#include "linux/positions/PositionSource.h"
#include "linux/positions/Retry.h"

class QDBusPendingCall;
class QDBusMessage;

namespace ktr::linux_ {

/// Positions from GeoClue (org.freedesktop.GeoClue2). Without a bus, GeoClue or the user's consent it tells nothing and
/// asks again from time to time; it follows GeoClue when it restarts. Main thread.
class GeoClueSource : public QObject, public PositionSource {
    Q_OBJECT

  public:
    /// The bus: the system's, but for tests. `desktopId` names this program's desktop file to the user.
    GeoClueSource(std::shared_ptr<platform::MainLoop> mainLoop, QString desktopId,
                  QDBusConnection bus = QDBusConnection::systemBus());
    ~GeoClueSource() override;

    void start(double desiredAccuracy) override;
    void stop() override;

  private Q_SLOTS:
    void locationUpdated(const QDBusObjectPath& before, const QDBusObjectPath& now);

  private:
    void askForClient();
    void useClient(const QString& path);
    void startClient();
    void readLocation(const QString& path);
    void forgetClient();
    unsigned accuracyLevel() const;

    Retry retry_;
    const QString desktopId_;
    QDBusConnection bus_;
    QString client_;
    double accuracy_ = 0.0;
    bool started_ = false;
    /// Counts starts and losses: an answer that belongs to an earlier one is void.
    unsigned round_ = 0;
};

}  // namespace ktr::linux_
