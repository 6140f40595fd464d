#pragma once

#include <utility>
// Boost 1.74 forgets to include <utility>.
#include <boost/asio/io_context.hpp>
#include <boost/asio/posix/stream_descriptor.hpp>
#include <boost/asio/steady_timer.hpp>
#include <boost/asio/strand.hpp>
#include <chrono>
#include <memory>

#include "server/http/HttpConnection.h"
#include "server/http/ListeningSocket.h"

namespace ktr::server {

/// Makes connections of those who knock at one socket. All but the constructor happens on its strand.
class Acceptor {
  public:
    using Strand = boost::asio::strand<boost::asio::io_context::executor_type>;

    Acceptor(Strand strand, ListeningSocket socket, std::shared_ptr<const HttpConnection::Setup> setup);
    ~Acceptor();
    Acceptor(const Acceptor&) = delete;
    Acceptor& operator=(const Acceptor&) = delete;

    void accept();
    /// Nobody is let in any more, and the socket is gone.
    void stop();

  private:
    using Timer = boost::asio::basic_waitable_timer<std::chrono::steady_clock,
                                                    boost::asio::wait_traits<std::chrono::steady_clock>, Strand>;

    void acceptLater();
    void welcome(int descriptor, HttpConnection::Client client);

    std::unique_ptr<ListeningSocket> socket_;
    const std::shared_ptr<const HttpConnection::Setup> setup_;
    boost::asio::posix::basic_stream_descriptor<Strand> knocking_;
    Timer rest_;
    bool stopped_ = false;
};

}  // namespace ktr::server
