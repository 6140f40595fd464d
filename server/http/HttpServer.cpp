#include "server/http/HttpServer.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <pthread.h>
#include <sys/socket.h>
#include <unistd.h>

#include <utility>
// Boost 1.74 forgets to include <utility>.
#include <array>
#include <boost/asio/executor_work_guard.hpp>
#include <boost/asio/io_context.hpp>
#include <boost/asio/posix/stream_descriptor.hpp>
#include <boost/asio/post.hpp>
#include <boost/asio/steady_timer.hpp>
#include <boost/asio/strand.hpp>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <future>
#include <map>
#include <optional>
#include <thread>
#include <vector>

#include "server/http/ConnectionTable.h"
#include "server/http/HttpConnection.h"

namespace ktr::server {

namespace asio = boost::asio;

namespace {

/// How many clients may knock while we are busy; the system has a bound of its own.
constexpr int kBacklog = 1024;
/// Before we look again whether there are descriptors for another client.
constexpr std::chrono::milliseconds kWithoutDescriptors{100};

struct Address {
    sockaddr_storage bytes{};
    socklen_t size = 0;
};

std::optional<Address> addressOf(const std::string& text, int port) {
    Address address;
    auto* four = reinterpret_cast<sockaddr_in*>(&address.bytes);
    auto* six = reinterpret_cast<sockaddr_in6*>(&address.bytes);
    if (::inet_pton(AF_INET, text.c_str(), &four->sin_addr) == 1) {
        four->sin_family = AF_INET;
        four->sin_port = htons(static_cast<std::uint16_t>(port));
        address.size = sizeof *four;
    } else if (::inet_pton(AF_INET6, text.c_str(), &six->sin6_addr) == 1) {
        six->sin6_family = AF_INET6;
        six->sin6_port = htons(static_cast<std::uint16_t>(port));
        address.size = sizeof *six;
    } else {
        return std::nullopt;
    }
    return address;
}

/// The client's address; of IPv6 the network that is given to one customer, since each has all of its addresses.
std::string peerOf(const sockaddr_storage& bytes) {
    std::array<char, INET6_ADDRSTRLEN> text{};
    if (bytes.ss_family == AF_INET) {
        ::inet_ntop(AF_INET, &reinterpret_cast<const sockaddr_in*>(&bytes)->sin_addr, text.data(), text.size());
    } else if (bytes.ss_family == AF_INET6) {
        in6_addr address = reinterpret_cast<const sockaddr_in6*>(&bytes)->sin6_addr;
        if (IN6_IS_ADDR_V4MAPPED(&address)) {
            ::inet_ntop(AF_INET, &address.s6_addr[12], text.data(), text.size());
            return text.data();
        }
        std::memset(&address.s6_addr[8], 0, 8);
        ::inet_ntop(AF_INET6, &address, text.data(), text.size());
    }
    return text.data();
}

int portOf(int descriptor) {
    sockaddr_storage bytes{};
    socklen_t size = sizeof bytes;
    if (::getsockname(descriptor, reinterpret_cast<sockaddr*>(&bytes), &size) != 0) {
        return 0;
    }
    return ntohs(bytes.ss_family == AF_INET6 ? reinterpret_cast<sockaddr_in6*>(&bytes)->sin6_port
                                             : reinterpret_cast<sockaddr_in*>(&bytes)->sin_port);
}

}  // namespace

class HttpServer::Listener {
  public:
    explicit Listener(Setup setup)
        : threadCount_(setup.threads),
          address_(std::move(setup.address)),
          port_(setup.port),
          loop_(std::make_shared<asio::io_context>(setup.threads)),
          strand_(asio::make_strand(*loop_)),
          socket_(strand_),
          rest_(strand_) {
        auto shared = std::make_shared<HttpConnection::Setup>();
        shared->loop = loop_;
        shared->table = std::make_shared<ConnectionTable>(setup.limits);
        shared->tls = std::move(setup.tls);
        shared->limits = setup.limits;
        shared->handler = std::move(setup.handler);
        shared_ = std::move(shared);
    }

    std::string start() {
        const auto address = addressOf(address_, port_);
        if (!address) {
            return address_ + ": is no address";
        }
        const int descriptor = ::socket(address->bytes.ss_family, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
        const int yes = 1;
        // A port whose last user has ended is free; one in use is not (SO_REUSEPORT would share it).
        const bool listens =
            descriptor >= 0 && ::setsockopt(descriptor, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes) == 0 &&
            ::bind(descriptor, reinterpret_cast<const sockaddr*>(&address->bytes), address->size) == 0 &&
            ::listen(descriptor, kBacklog) == 0;
        if (!listens) {
            const std::string reason = std::strerror(errno);
            if (descriptor >= 0) {
                ::close(descriptor);
            }
            return "port " + std::to_string(port_) + " of " + address_ + " cannot be used: " + reason;
        }
        port_ = portOf(descriptor);
        socket_.assign(descriptor);
        asio::post(strand_, [this] { accept(); });
        for (int i = 0; i < threadCount_; ++i) {
            threads_.emplace_back([this] { run(); });
        }
        return "";
    }

    void stop(std::chrono::milliseconds grace) {
        if (threads_.empty()) {
            return;
        }
        std::promise<void> closed;
        asio::post(strand_, [this, &closed] {
            stopping_ = true;
            // What is said of it changes nothing: the descriptor is gone.
            boost::system::error_code ignored;
            socket_.close(ignored);
            rest_.cancel();
            for (const auto& [timer, kept] : timers_) {
                kept->cancel();
            }
            closed.set_value();
        });
        // Nobody joins the table after this.
        closed.get_future().wait();
        const auto end = std::chrono::steady_clock::now() + grace;
        for (;;) {
            const bool over = std::chrono::steady_clock::now() >= end;
            bool answering = false;
            for (const auto& connection : shared_->table->all()) {
                if (over || !connection->isAnswering()) {
                    connection->close();
                } else {
                    answering = true;
                }
            }
            if (!answering) {
                break;
            }
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        // With nothing left to wait for, the threads end by themselves.
        work_.reset();
        for (std::thread& thread : threads_) {
            thread.join();
        }
        threads_.clear();
    }

    int port() const { return port_; }

    void later(double seconds, std::function<void()> what) {
        asio::post(strand_, [this, seconds, what = std::move(what)]() mutable {
            if (stopping_) {
                return;
            }
            auto timer =
                std::make_shared<Timer>(strand_, std::chrono::duration_cast<std::chrono::steady_clock::duration>(
                                                     std::chrono::duration<double>(std::min(seconds, 1.0e6))));
            timers_[timer.get()] = timer;
            timer->async_wait([this, timer, what = std::move(what)](const boost::system::error_code& failure) mutable {
                timers_.erase(timer.get());
                if (!failure) {
                    asio::post(*loop_, std::move(what));
                }
            });
        });
    }

  private:
    using Strand = asio::strand<asio::io_context::executor_type>;
    using Timer =
        asio::basic_waitable_timer<std::chrono::steady_clock, asio::wait_traits<std::chrono::steady_clock>, Strand>;

    void run() {
        // A client that goes away while it is written to.
        sigset_t pipe;
        sigemptyset(&pipe);
        sigaddset(&pipe, SIGPIPE);
        ::pthread_sigmask(SIG_BLOCK, &pipe, nullptr);
        loop_->run();
    }

    void accept() {
        for (;;) {
            sockaddr_storage bytes{};
            socklen_t size = sizeof bytes;
            const int descriptor = ::accept4(socket_.native_handle(), reinterpret_cast<sockaddr*>(&bytes), &size,
                                             SOCK_NONBLOCK | SOCK_CLOEXEC);
            if (descriptor >= 0) {
                welcome(descriptor, peerOf(bytes));
            } else if (errno == EAGAIN || errno == EWOULDBLOCK) {
                break;
            } else if (errno == EMFILE || errno == ENFILE || errno == ENOBUFS || errno == ENOMEM) {
                return acceptLater();
            } else if (errno != EINTR && errno != ECONNABORTED && errno != EPROTO && errno != EPERM) {
                return;
            }
        }
        socket_.async_wait(asio::posix::descriptor_base::wait_read, [this](const boost::system::error_code& failure) {
            if (!failure && !stopping_) {
                accept();
            }
        });
    }

    void acceptLater() {
        rest_.expires_after(kWithoutDescriptors);
        rest_.async_wait([this](const boost::system::error_code& failure) {
            if (!failure && !stopping_) {
                accept();
            }
        });
    }

    void welcome(int descriptor, std::string peer) {
        const int yes = 1;
        ::setsockopt(descriptor, IPPROTO_TCP, TCP_NODELAY, &yes, sizeof yes);
        const auto connection = std::make_shared<HttpConnection>(shared_, descriptor, std::move(peer));
        if (shared_->table->add(connection)) {
            connection->start();
        }
    }

    const int threadCount_;
    const std::string address_;
    int port_;
    const std::shared_ptr<asio::io_context> loop_;
    std::shared_ptr<const HttpConnection::Setup> shared_;
    Strand strand_;
    asio::posix::basic_stream_descriptor<Strand> socket_;
    Timer rest_;
    std::map<Timer*, std::shared_ptr<Timer>> timers_;
    bool stopping_ = false;  ///< on the strand
    std::optional<asio::executor_work_guard<asio::io_context::executor_type>> work_{asio::make_work_guard(*loop_)};
    std::vector<std::thread> threads_;
};

HttpServer::HttpServer(Setup setup) : listener_(std::make_unique<Listener>(std::move(setup))) {}

HttpServer::~HttpServer() {
    stop();
}

std::string HttpServer::start() {
    return listener_->start();
}

void HttpServer::stop(std::chrono::milliseconds grace) {
    listener_->stop(grace);
}

int HttpServer::port() const {
    return listener_->port();
}

void HttpServer::later(double seconds, std::function<void()> what) {
    listener_->later(seconds, std::move(what));
}

}  // namespace ktr::server
