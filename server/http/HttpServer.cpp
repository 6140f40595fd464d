#include "server/http/HttpServer.h"

#include <pthread.h>

#include <utility>
// Boost 1.74 forgets to include <utility>.
#include <boost/asio/executor_work_guard.hpp>
#include <boost/asio/io_context.hpp>
#include <boost/asio/post.hpp>
#include <boost/asio/steady_timer.hpp>
#include <boost/asio/strand.hpp>
#include <csignal>
#include <future>
#include <map>
#include <optional>
#include <thread>
#include <vector>

#include "server/http/Acceptor.h"
#include "server/http/ConnectionTable.h"
#include "server/http/HttpConnection.h"

namespace ktr::server {

namespace asio = boost::asio;

class HttpServer::Listener {
  public:
    explicit Listener(Setup setup)
        : setup_(std::move(setup)),
          loop_(std::make_shared<asio::io_context>(setup_.threads)),
          counters_(std::make_shared<EdgeCounters>()),
          table_(std::make_shared<ConnectionTable>(setup_.limits, counters_)),
          strand_(asio::make_strand(*loop_)) {}

    std::string start() {
        std::string complaint;
        std::vector<ListeningSocket> sockets;
        for (const int descriptor : setup_.inherited) {
            add(ListeningSocket::inherited(descriptor, complaint), sockets);
        }
        if (!setup_.place.path.empty()) {
            add(ListeningSocket::at(setup_.place, complaint), sockets);
        }
        if (!setup_.address.empty()) {
            add(ListeningSocket::onAddress(setup_.address, setup_.port, complaint), sockets);
        }
        for (const ListeningSocket& socket : sockets) {
            if (complaint.empty() && !setup_.tls && !socket.isLocal()) {
                complaint = "without a certificate only this machine may be served, or a proxy through a socket";
            }
        }
        if (!complaint.empty()) {
            return complaint;
        }
        for (ListeningSocket& socket : sockets) {
            port_ = socket.isFile() ? port_ : socket.port();
            auto setup = connectionSetup(socket.isFile());
            acceptors_.push_back(std::make_unique<Acceptor>(strand_, std::move(socket), std::move(setup)));
        }
        asio::post(strand_, [this] {
            for (const auto& acceptor : acceptors_) {
                acceptor->accept();
            }
        });
        for (int i = 0; i < setup_.threads; ++i) {
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
            for (const auto& acceptor : acceptors_) {
                acceptor->stop();
            }
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
            for (const auto& connection : table_->all()) {
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

    std::string numbers() const {
        return counters_->text() + "# TYPE ktr_service_connections gauge\nktr_service_connections " +
               std::to_string(table_->size()) + "\n";
    }

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

    static void add(std::optional<ListeningSocket> socket, std::vector<ListeningSocket>& sockets) {
        if (socket) {
            sockets.push_back(std::move(*socket));
        }
    }

    /// TLS is between a client and this program: a proxy beside it has ended it already.
    std::shared_ptr<const HttpConnection::Setup> connectionSetup(bool isFile) const {
        auto shared = std::make_shared<HttpConnection::Setup>();
        shared->loop = loop_;
        shared->table = table_;
        shared->tls = isFile ? nullptr : setup_.tls;
        shared->limits = setup_.limits;
        shared->handler = setup_.handler;
        shared->tooLong = setup_.tooLong;
        shared->counters = counters_;
        return shared;
    }

    const Setup setup_;
    int port_ = 0;
    const std::shared_ptr<asio::io_context> loop_;
    const std::shared_ptr<EdgeCounters> counters_;
    const std::shared_ptr<ConnectionTable> table_;
    Strand strand_;
    std::vector<std::unique_ptr<Acceptor>> acceptors_;
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

std::string HttpServer::numbers() const {
    return listener_->numbers();
}

void HttpServer::later(double seconds, std::function<void()> what) {
    listener_->later(seconds, std::move(what));
}

}  // namespace ktr::server
