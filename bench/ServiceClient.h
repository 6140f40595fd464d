#pragma once

#include <openssl/ssl.h>

#include <memory>
#include <optional>
#include <string>

namespace ktr::bench {

/// One kept connection to a service on this machine, with TLS or without. It waits. One thread.
class ServiceClient {
  public:
    /// To a port with TLS, from one of this machine's own addresses (127.0.0.0/8).
    ServiceClient(int port, const std::string& from);
    /// To a socket in the file system, without TLS.
    explicit ServiceClient(const std::string& path);
    ~ServiceClient();
    ServiceClient(const ServiceClient&) = delete;
    ServiceClient& operator=(const ServiceClient&) = delete;

    bool connected() const { return connected_; }
    bool send(const std::string& bytes);
    /// The status of the next answer; none when the connection ended.
    std::optional<int> readStatus();
    std::optional<int> ask(const std::string& request);

  private:
    bool readMore();

    int descriptor_ = -1;
    bool connected_ = false;
    std::unique_ptr<SSL_CTX, decltype(&SSL_CTX_free)> context_{nullptr, SSL_CTX_free};
    std::unique_ptr<SSL, decltype(&SSL_free)> tls_{nullptr, SSL_free};
    std::string waiting_;
};

/// A request of HTTP/1.1.
std::string postOf(const std::string& path, const std::string& credentials, const std::string& body,
                   const std::string& more = "");

}  // namespace ktr::bench
