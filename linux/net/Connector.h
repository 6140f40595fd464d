#pragma once

#include <QHostAddress>
#include <QHostInfo>
#include <QObject>
#include <QSslSocket>
#include <QTimer>
#include <functional>
#include <string>
#include <vector>

namespace ktr::linux_ {

/// Makes one connection to a name or an address. A name may have several addresses, of which some lead nowhere: each
/// gets a start before the next is tried beside it, and the first that is connected is taken (RFC 8305). Lives on one
/// thread with an event loop.
class Connector : public QObject {
  public:
    /// Milliseconds that an address has for itself.
    static constexpr int kStart = 250;
    static constexpr std::size_t kMostAddresses = 8;

    /// Not encrypted yet.
    using Connected = std::function<void(QSslSocket* socket)>;
    /// With words for a log line.
    using Failed = std::function<void(std::string reason)>;

    Connector(Connected connected, Failed failed);
    /// Gives up what is under way.
    ~Connector() override;

    /// Calls one of the two once, never inside the call. The receiver owns the socket.
    void start(const std::string& host, int port);

  private:
    void resolved(const QHostInfo& info);
    void tryNext();
    void attemptFailed(QSslSocket* socket);
    void fail(const std::string& reason);

    Connected connected_;
    Failed failed_;
    quint16 port_ = 0;
    int lookup_ = -1;
    std::vector<QHostAddress> waiting_;  ///< the next one last
    std::vector<QSslSocket*> underWay_;
    QTimer start_;
};

}  // namespace ktr::linux_
