#pragma once

#include <QTcpServer>
#include <QTcpSocket>
#include <QTimer>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "app/voice/PeerList.h"
#include "app/voice/WyomingFrames.h"

namespace ktr::app {

/// Answers voice assistants over TCP: `describe` with what this is, `transcript` with a sentence. The protocol knows no
/// password: who may connect is decided by address alone. Everything of a peer is bounded: connections, frames, bytes,
/// time. Keeps nothing of a question or an answer. Main thread.
class WyomingServer : public QObject {
  public:
    struct Said {
        std::string text;
        bool isUnderstood = false;
    };
    using Answer = std::function<void(Said)>;
    struct Setup {
        PeerList peers;
        std::vector<std::string> languages;  ///< BCP 47
        std::string version;
        /// Answers a question in a language, which may be empty. Calls back once, perhaps at once.
        std::function<void(const std::string& text, const std::string& language, const Answer&)> ask;
        int patience = 10000;  ///< milliseconds for a peer's next frame
    };

    static constexpr std::size_t kMostConnections = 16;
    static constexpr int kMostFrames = 64;  ///< of one connection

    explicit WyomingServer(Setup setup);
    /// Empty, or why not. Port 0 is a free one.
    std::string listen(const QHostAddress& address, quint16 port);
    quint16 port() const { return server_.serverPort(); }

  private:
    struct Connection;

    void accept();
    void read(Connection& connection);
    /// False: the connection is to be closed.
    bool handle(Connection& connection, const WyomingFrames::Frame& frame);
    void ask(Connection& connection, const WyomingFrames::Frame& frame);
    static void close(Connection& connection);
    platform::Dictionary information() const;

    const Setup setup_;
    QTcpServer server_;
    std::size_t connections_ = 0;
};

}  // namespace ktr::app
