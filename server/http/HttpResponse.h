#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace ktr::server {

class HttpStream;

/// How an answer travels when it is to go wrong on purpose, for those who test a client.
struct HttpDelivery {
    bool reset = false;                   ///< the connection is reset instead of any answer
    std::optional<std::size_t> cutAfter;  ///< it ends after so many bytes of the body, of which the headers promise all
    double bytesPerSecond = 0.0;          ///< how slowly the body comes, a byte at a time; 0: as fast as it goes
    bool endless = false;                 ///< blanks without end instead of the body

    bool operator==(const HttpDelivery&) const = default;
};

/// An answer. A value.
struct HttpResponse {
    int status = 200;
    /// Without Content-Length and Connection, which the edge writes. Control characters in a value become blanks.
    std::vector<std::pair<std::string, std::string>> headers;
    std::string body;
    HttpDelivery delivery = {};
    /// What follows the body, bit by bit; none: nothing.
    std::shared_ptr<HttpStream> stream = {};

    static HttpResponse json(int status, std::string body);
    /// Status line and headers with the empty line after them.
    std::string head(bool keepsAlive) const;
};

}  // namespace ktr::server
