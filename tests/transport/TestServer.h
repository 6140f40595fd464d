#pragma once

#include <functional>
#include <mutex>
#include <string>
#include <vector>

#include <QSslSocket>
#include <QString>
#include <QThread>

namespace ktr::test {

/// A server on loopback, on a thread of its own, that keeps every byte it is told and does with a request whatever a
/// test wants.
class TestServer {
  public:
    struct Request {
        std::string head;  ///< up to the empty line
        std::string body;
    };
    /// Called on the server's thread with each complete request.
    using Behaviour = std::function<void(QSslSocket& socket, const Request& request)>;
    struct Options {
        /// Empty: plain TCP.
        QString certificate;
        QString key;
        QSsl::SslProtocol protocol = QSsl::SecureProtocols;
        /// Called on the server's thread when a connection is there, encrypted if it is to be.
        std::function<void(QSslSocket& socket)> connected;
        /// Breaks every connection at once, before a handshake.
        bool refuses = false;
    };

    TestServer(Options options, Behaviour behaviour);
    ~TestServer();
    TestServer(const TestServer&) = delete;
    TestServer& operator=(const TestServer&) = delete;

    int port() const { return port_; }
    /// "localhost:port".
    std::string host() const { return "localhost:" + std::to_string(port_); }
    std::string url(const std::string& path) const { return "https://" + host() + path; }

    /// Connections that were made, whatever became of them.
    int connections() const;
    /// Bytes that arrived, decrypted.
    std::string received() const;
    std::vector<Request> requests() const;
    /// How often a POST began to arrive.
    std::size_t posts() const;

  private:
    class Listener;
    void arrived(QSslSocket& socket);

    Options options_;
    Behaviour behaviour_;
    QThread thread_;
    Listener* listener_;
    int port_ = 0;
    mutable std::mutex mutex_;
    int connections_ = 0;
    std::string received_;
    std::vector<Request> requests_;
};

/// Writes an answer and closes the connection.
void answerWith(QSslSocket& socket, int status, const std::string& fields, const std::string& body);

}  // namespace ktr::test
