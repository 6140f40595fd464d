#include "bench/ServiceClient.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>

namespace ktr::bench {

ServiceClient::ServiceClient(int port, const std::string& from)
    : descriptor_(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)),
      context_(SSL_CTX_new(TLS_client_method()), SSL_CTX_free) {
    sockaddr_in address{};
    address.sin_family = AF_INET;
    const int yes = 1;
    ::setsockopt(descriptor_, IPPROTO_IP, IP_BIND_ADDRESS_NO_PORT, &yes, sizeof yes);
    ::inet_pton(AF_INET, from.c_str(), &address.sin_addr);
    ::bind(descriptor_, reinterpret_cast<sockaddr*>(&address), sizeof address);
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    address.sin_port = htons(static_cast<std::uint16_t>(port));
    if (::connect(descriptor_, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
        return;
    }
    ::setsockopt(descriptor_, IPPROTO_TCP, TCP_NODELAY, &yes, sizeof yes);
    tls_.reset(SSL_new(context_.get()));
    SSL_set_fd(tls_.get(), descriptor_);
    connected_ = SSL_connect(tls_.get()) == 1;
}

ServiceClient::ServiceClient(const std::string& path) : descriptor_(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::strncpy(address.sun_path, path.c_str(), sizeof address.sun_path - 1);
    connected_ = ::connect(descriptor_, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0;
}

ServiceClient::~ServiceClient() {
    ::close(descriptor_);
}

bool ServiceClient::send(const std::string& bytes) {
    if (tls_) {
        return SSL_write(tls_.get(), bytes.data(), static_cast<int>(bytes.size())) == static_cast<int>(bytes.size());
    }
    return ::send(descriptor_, bytes.data(), bytes.size(), MSG_NOSIGNAL) == static_cast<ssize_t>(bytes.size());
}

bool ServiceClient::readMore() {
    char block[16384];
    const auto count = tls_ ? SSL_read(tls_.get(), block, sizeof block)
                            : static_cast<int>(::recv(descriptor_, block, sizeof block, 0));
    if (count <= 0) {
        return false;
    }
    waiting_.append(block, static_cast<std::size_t>(count));
    return true;
}

std::optional<int> ServiceClient::readStatus() {
    std::size_t end = std::string::npos;
    while ((end = waiting_.find("\r\n\r\n")) == std::string::npos) {
        if (!readMore()) {
            return std::nullopt;
        }
    }
    const std::string head = waiting_.substr(0, end + 4);
    const std::size_t length = head.find("Content-Length: ");
    const std::size_t body = length == std::string::npos ? 0 : std::strtoul(head.c_str() + length + 16, nullptr, 10);
    while (waiting_.size() < head.size() + body) {
        if (!readMore()) {
            return std::nullopt;
        }
    }
    waiting_.erase(0, head.size() + body);
    return std::atoi(head.c_str() + std::strlen("HTTP/1.1 "));
}

std::optional<int> ServiceClient::ask(const std::string& request) {
    return send(request) ? readStatus() : std::nullopt;
}

std::string postOf(const std::string& path, const std::string& credentials, const std::string& body,
                   const std::string& more) {
    return "POST " + path +
           " HTTP/1.1\r\nHost: localhost\r\nContent-Type: application/json\r\nAuthorization: " + credentials + "\r\n" +
           more + "Content-Length: " + std::to_string(body.size()) + "\r\n\r\n" + body;
}

}  // namespace ktr::bench
