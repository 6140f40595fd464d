#include "server/http/Acceptor.h"

#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sys/socket.h>

#include <cerrno>

#include "server/http/ClientAddress.h"
#include "server/http/ConnectionTable.h"

namespace ktr::server {

namespace {

/// Before we look again whether there are descriptors for another client.
constexpr std::chrono::milliseconds kWithoutDescriptors{100};

}  // namespace

Acceptor::Acceptor(Strand strand, ListeningSocket socket, std::shared_ptr<const HttpConnection::Setup> setup)
    : socket_(std::make_unique<ListeningSocket>(std::move(socket))),
      setup_(std::move(setup)),
      knocking_(strand, socket_->descriptor()),
      rest_(strand) {}

Acceptor::~Acceptor() {
    stop();
}

void Acceptor::stop() {
    if (!stopped_) {
        stopped_ = true;
        // The descriptor belongs to the socket.
        knocking_.release();
        rest_.cancel();
        socket_.reset();
    }
}

void Acceptor::accept() {
    while (!stopped_) {
        sockaddr_storage bytes{};
        socklen_t size = sizeof bytes;
        const int descriptor =
            ::accept4(socket_->descriptor(), reinterpret_cast<sockaddr*>(&bytes), &size, SOCK_NONBLOCK | SOCK_CLOEXEC);
        if (descriptor >= 0) {
            const bool isFile = bytes.ss_family == AF_UNIX;
            welcome(descriptor, {ClientAddress::of(bytes), isFile || ClientAddress::isLoopback(bytes)});
        } else if (errno == EAGAIN || errno == EWOULDBLOCK) {
            break;
        } else if (errno == EMFILE || errno == ENFILE || errno == ENOBUFS || errno == ENOMEM) {
            return acceptLater();
        } else if (errno != EINTR && errno != ECONNABORTED && errno != EPROTO && errno != EPERM) {
            return;
        }
    }
    if (stopped_) {
        return;
    }
    knocking_.async_wait(boost::asio::posix::descriptor_base::wait_read,
                         [this](const boost::system::error_code& failure) {
                             if (!failure) {
                                 accept();
                             }
                         });
}

void Acceptor::acceptLater() {
    rest_.expires_after(kWithoutDescriptors);
    rest_.async_wait([this](const boost::system::error_code& failure) {
        if (!failure) {
            accept();
        }
    });
}

void Acceptor::welcome(int descriptor, HttpConnection::Client client) {
    if (!client.address.empty()) {
        const int yes = 1;
        ::setsockopt(descriptor, IPPROTO_TCP, TCP_NODELAY, &yes, sizeof yes);
    }
    const auto connection = std::make_shared<HttpConnection>(setup_, descriptor, std::move(client));
    if (setup_->table->add(connection)) {
        connection->start();
    }
}

}  // namespace ktr::server
