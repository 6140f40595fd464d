#pragma once

#include <openssl/ssl.h>

#include <chrono>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "server/http/HttpHandler.h"
#include "server/http/HttpLimits.h"
#include "server/http/ListeningSocket.h"

namespace ktr::server {

/// A strict HTTP/1.1 edge: an address, a socket for a proxy, or both; a few threads, as many connections as its limits
/// say. Plain HTTP never leaves the machine. What is public belongs to the thread that made it, but for `later` and
/// `numbers`.
class HttpServer {
  public:
    struct Setup {
        std::string address = "127.0.0.1";  ///< an IPv4 or IPv6 address; empty: none
        int port = 0;                       ///< 0: a free one
        std::shared_ptr<SSL_CTX> tls;       ///< for addresses; none: without TLS, which only loopback may be
        ListeningSocket::Place place = {};  ///< where a proxy finds it; without a path: nowhere
        std::vector<int> inherited = {};    ///< sockets that whoever started this process made
        HttpLimits limits;
        HttpHandler handler;
        /// Answers a request whose body is longer than the limits say, by its header alone: the body is not read, and
        /// the connection ends with the answer. None: such a request gets 413.
        HttpHandler tooLong = {};
        int threads = 2;
    };

    explicit HttpServer(Setup setup);
    /// Stops.
    ~HttpServer();
    HttpServer(const HttpServer&) = delete;
    HttpServer& operator=(const HttpServer&) = delete;

    /// Takes its sockets and begins to answer. Empty when done, else what failed: the port may be somebody else's.
    std::string start();
    /// Lets nobody in any more, closes what waits, gives answers under way this long, breaks off what is left, and
    /// returns when all threads have ended.
    void stop(std::chrono::milliseconds grace = std::chrono::milliseconds(2000));
    /// After `start`; 0 without an address.
    int port() const;
    /// What became of connections, in the text format of Prometheus. Any thread.
    std::string numbers() const;
    /// Calls `what` after so many seconds on one of the threads; drops it when the server stops before. Any thread.
    void later(double seconds, std::function<void()> what);

  private:
    class Listener;
    std::unique_ptr<Listener> listener_;
};

}  // namespace ktr::server
