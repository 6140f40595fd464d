#pragma once

#include <arpa/inet.h>
#include <gtest/gtest.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <chrono>
#include <cstdint>
#include <cstring>
#include <string>

namespace ktr::test {

/// A client that sends and reads exactly what it is told.
class RawClient {
  public:
    /// From an address of this machine's own (127.0.0.0/8).
    explicit RawClient(int port, const std::string& from = "127.0.0.1")
        : descriptor_(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        ::inet_pton(AF_INET, from.c_str(), &address.sin_addr);
        EXPECT_EQ(::bind(descriptor_, reinterpret_cast<sockaddr*>(&address), sizeof address), 0) << from;
        address.sin_port = htons(static_cast<std::uint16_t>(port));
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        connected_ = ::connect(descriptor_, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0;
    }
    /// To a socket in the file system.
    explicit RawClient(const std::string& path) : descriptor_(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        std::strncpy(address.sun_path, path.c_str(), sizeof address.sun_path - 1);
        connected_ = ::connect(descriptor_, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0;
    }
    ~RawClient() { ::close(descriptor_); }
    RawClient(const RawClient&) = delete;
    RawClient& operator=(const RawClient&) = delete;

    bool connected() const { return connected_; }
    void send(const std::string& bytes) const { ::send(descriptor_, bytes.data(), bytes.size(), MSG_NOSIGNAL); }
    /// What comes until `end` stands in it, the other side ends, or the time is over.
    std::string read(const std::string& end, std::chrono::milliseconds time = std::chrono::milliseconds(5000)) const {
        const auto until = std::chrono::steady_clock::now() + time;
        std::string text;
        while (text.find(end) == std::string::npos || end.empty()) {
            const auto left =
                std::chrono::duration_cast<std::chrono::milliseconds>(until - std::chrono::steady_clock::now());
            pollfd wait{descriptor_, POLLIN, 0};
            char block[4096];
            if (left.count() <= 0 || ::poll(&wait, 1, static_cast<int>(left.count())) <= 0) {
                return text + "(nothing more in time)";
            }
            const ssize_t count = ::recv(descriptor_, block, sizeof block, 0);
            if (count <= 0) {
                return text + "(end)";
            }
            text.append(block, static_cast<std::size_t>(count));
        }
        return text;
    }
    std::string get(const std::string& path = "/") const {
        send("GET " + path + " HTTP/1.1\r\nHost: localhost\r\n\r\n");
        return read("ok:" + path);
    }

  private:
    int descriptor_;
    bool connected_ = false;
};

}  // namespace ktr::test
