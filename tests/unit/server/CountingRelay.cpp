#include "tests/unit/server/CountingRelay.h"

#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <array>
#include <cstring>
#include <utility>

namespace ktr::test {

namespace {

/// Milliseconds after which it looks whether it is to end.
constexpr int kLook = 20;

sockaddr_un socketIn(const std::string& folder) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::strncpy(address.sun_path, (folder + "/.s.PGSQL.5432").c_str(), sizeof address.sun_path - 1);
    return address;
}

}  // namespace

CountingRelay::CountingRelay(std::string target, const std::string& folder) : target_(std::move(target)) {
    const int made = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    const sockaddr_un address = socketIn(folder);
    if (::bind(made, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 || ::listen(made, 16) != 0) {
        ::close(made);
        return;
    }
    listener_ = made;
    thread_ = std::thread([this] { run(); });
}

CountingRelay::~CountingRelay() {
    ending_ = true;
    if (thread_.joinable()) {
        thread_.join();
    }
    for (const Pair& pair : pairs_) {
        for (const int one : {pair.client, pair.server}) {
            if (one >= 0) {
                ::close(one);
            }
        }
    }
    if (listener_ >= 0) {
        ::close(listener_);
    }
}

std::size_t CountingRelay::connections() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return pairs_.size();
}

int CountingRelay::waysOf(std::size_t connection) const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return connection < pairs_.size() ? pairs_[connection].ways : 0;
}

void CountingRelay::accept() {
    Pair pair;
    pair.client = ::accept4(listener_, nullptr, nullptr, SOCK_CLOEXEC);
    pair.server = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    const sockaddr_un address = socketIn(target_);
    if (::connect(pair.server, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) {
        ::shutdown(pair.client, SHUT_RDWR);
    }
    pairs_.push_back(pair);
}

bool CountingRelay::pass(int from, int to) {
    std::array<char, 65536> bytes;
    const ssize_t size = ::read(from, bytes.data(), bytes.size());
    for (ssize_t sent = 0; sent < size;) {
        const ssize_t count = ::send(to, bytes.data() + sent, static_cast<std::size_t>(size - sent), MSG_NOSIGNAL);
        if (count <= 0) {
            return false;
        }
        sent += count;
    }
    return size > 0;
}

void CountingRelay::run() {
    while (!ending_) {
        std::vector<pollfd> all{{listener_, POLLIN, 0}};
        for (const Pair& pair : pairs_) {
            all.push_back({pair.client, POLLIN, 0});
            all.push_back({pair.server, POLLIN, 0});
        }
        if (::poll(all.data(), all.size(), kLook) <= 0) {
            continue;
        }
        const std::lock_guard<std::mutex> lock(mutex_);
        for (std::size_t i = 0; 2 * i + 2 < all.size(); ++i) {
            Pair& pair = pairs_[i];
            bool goesOn = true;
            if (all[2 * i + 1].revents != 0) {
                pair.ways += std::exchange(pair.serverSpokeLast, false) ? 1 : 0;
                goesOn = pass(pair.client, pair.server);
            }
            if (goesOn && all[2 * i + 2].revents != 0) {
                pair.serverSpokeLast = true;
                goesOn = pass(pair.server, pair.client);
            }
            if (!goesOn) {
                ::close(std::exchange(pair.client, -1));
                ::close(std::exchange(pair.server, -1));
            }
        }
        if (all.front().revents != 0) {
            accept();
        }
    }
}

}  // namespace ktr::test
