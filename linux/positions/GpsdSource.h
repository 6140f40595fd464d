#pragma once

#include <QByteArray>
#include <QObject>
#include <QString>
#include <memory>
#include <optional>

#include "linux/positions/PositionSource.h"
#include "linux/positions/Retry.h"

class QTcpSocket;

namespace ktr::linux_ {

/// Positions from gpsd over its JSON protocol (gpsd_json(5)): TPV reports in watcher mode. Connects again when gpsd
/// goes away. It always asks for all there is, whatever the accuracy. Main thread.
class GpsdSource : public PositionSource {
  public:
    GpsdSource(QString host, quint16 port, std::shared_ptr<platform::MainLoop> mainLoop);
    ~GpsdSource() override;

    void start(double desiredAccuracy) override;
    void stop() override;

    /// The fix that one line of gpsd carries; none for other reports, for one without a fix and for what is no report.
    static std::optional<platform::PlatformLocation::Fix> fixOf(const QByteArray& line);

  private:
    void connectToGpsd();
    void read();
    void lost();

    const QString host_;
    const quint16 port_;
    std::unique_ptr<QTcpSocket> socket_;
    Retry retry_;
    bool started_ = false;
};

}  // namespace ktr::linux_
