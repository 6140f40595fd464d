#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace ktr::server {

/// A whole request as the edge let it in: one that any reader of HTTP/1.1 (RFC 9112) understands in the same way. A
/// value.
struct HttpRequest {
    std::string method;
    std::string path;   ///< begins with "/", as it was sent: nothing is decoded
    std::string query;  ///< what follows the first "?", as it was sent
    std::vector<std::pair<std::string, std::string>> headers;
    std::string body;
    /// The client's address without its port, as the proxy names it where there is one; empty for a client at the
    /// proxy's socket itself.
    std::string peer;
    bool isLocal = false;  ///< the client is on this machine, and asks for itself: no proxy forwards it

    /// The first header of this name, in any case; none when there is none.
    const std::string* header(std::string_view name) const;
    /// The same, an empty text when there is none.
    std::string headerText(std::string_view name) const;
};

/// ASCII letters alike in either case.
bool equalIgnoringCase(std::string_view one, std::string_view other);

}  // namespace ktr::server
