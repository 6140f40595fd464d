#pragma once

#include <openssl/ssl.h>

#include <utility>
// Boost 1.74 forgets to include <utility>.
#include <atomic>
#include <boost/asio/io_context.hpp>
#include <boost/asio/posix/stream_descriptor.hpp>
#include <boost/asio/steady_timer.hpp>
#include <boost/asio/strand.hpp>
#include <chrono>
#include <cstddef>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "server/http/ByteSocket.h"
#include "server/http/EdgeCounters.h"
#include "server/http/HttpHandler.h"
#include "server/http/HttpLimits.h"
#include "server/http/RequestReader.h"

namespace ktr::server {

class ConnectionTable;

/// One client: reads a request, has it answered, sends the answer, and reads the next one. One timer watches over it,
/// set for the whole of what it waits for. Everything happens on its strand; `close` and `peer` may be called on any
/// thread.
class HttpConnection : public std::enable_shared_from_this<HttpConnection> {
  public:
    struct Setup {
        std::shared_ptr<boost::asio::io_context> loop;
        std::shared_ptr<ConnectionTable> table;
        std::shared_ptr<SSL_CTX> tls;  ///< none: without TLS
        HttpLimits limits;
        HttpHandler handler;
        HttpHandler tooLong = {};  ///< for requests that are refused for their length; none: 413
        std::shared_ptr<EdgeCounters> counters;
    };

    struct Client {
        std::string address;   ///< empty: it came through a socket in the file system
        bool isLocal = false;  ///< it is on this machine
    };

    /// Takes the descriptor, which does not block.
    HttpConnection(std::shared_ptr<const Setup> setup, int descriptor, Client client);
    ~HttpConnection();

    void start();
    void close();
    const std::string& peer() const { return client_.address; }
    /// Whether it is answering, or waits to.
    bool isAnswering() const { return answering_; }

  private:
    using Strand = boost::asio::strand<boost::asio::io_context::executor_type>;

    void receive();
    void act(RequestReader::State state);
    void answerRequest(const HttpHandler& handler);
    void tellClient(HttpRequest& request) const;
    void refuse();
    void send(HttpResponse response);
    void sendMore();
    void sendNextPiece();
    void sendNextOfStream();
    void resumeStream();
    void finishAnswer();
    void dropWhatComes();
    void waitFor(ByteSocket::Result what, void (HttpConnection::*then)());
    void setDeadline(std::chrono::milliseconds time);
    void closeNow();

    const std::shared_ptr<const Setup> setup_;
    const Client client_;
    boost::asio::posix::basic_stream_descriptor<Strand> descriptor_;
    boost::asio::basic_waitable_timer<std::chrono::steady_clock, boost::asio::wait_traits<std::chrono::steady_clock>,
                                      Strand>
        deadline_;
    boost::asio::basic_waitable_timer<std::chrono::steady_clock, boost::asio::wait_traits<std::chrono::steady_clock>,
                                      Strand>
        pace_;
    ByteSocket bytes_;
    RequestReader reader_;
    bool headerBegun_ = false;
    bool inBody_ = false;
    bool keepsAlive_ = false;
    bool closed_ = false;
    std::atomic<bool> answering_ = false;
    std::string out_;          ///< what is to be sent
    std::string rest_;         ///< and what slowly follows it
    std::size_t sent_ = 0;     ///< of it
    std::size_t dropped_ = 0;  ///< bytes that came after the last answer
    HttpDelivery delivery_;
    std::shared_ptr<HttpStream> stream_;  ///< of the answer that is being sent
};

}  // namespace ktr::server
