#pragma once

#include <sys/socket.h>

#include <string>

#include "server/http/HttpRequest.h"

namespace ktr::server {

/// Who a client is, as far as an address says. Any thread.
class ClientAddress {
  public:
    /// What stands for a client whose proxy does not say clearly who it is.
    static constexpr const char* kUnclear = "?";

    /// The address without a port; of IPv6 the network that is given to one customer, since each has all of its
    /// addresses. Empty for a socket in the file system.
    static std::string of(const sockaddr_storage& address);
    static bool isLoopback(const sockaddr_storage& address);

    /// Whether somebody else sent the request through a proxy.
    static bool isForwarded(const HttpRequest& request);
    /// For whom a proxy forwards it: the last one named in X-Forwarded-For or Forwarded (RFC 7239), since a client can
    /// write whatever comes before. Where both headers name somebody, and not the same, one of them is the client's own
    /// invention: `kUnclear`, as for what is no address.
    static std::string forwardedFor(const HttpRequest& request);
};

}  // namespace ktr::server
