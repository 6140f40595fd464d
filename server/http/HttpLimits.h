#pragma once

#include <chrono>
#include <cstddef>

namespace ktr::server {

/// What a client may ask of the edge. Times are for the whole of a thing, not between two bytes of it, so that nobody
/// holds a connection by dripping.
struct HttpLimits {
    std::size_t headerBytes = 16384;
    std::size_t headerFields = 100;
    std::size_t bodyBytes = std::size_t{1} << 20;
    std::chrono::milliseconds headerTime{10000};  ///< from the connection, or a request's first byte: TLS included
    std::chrono::milliseconds bodyTime{20000};
    std::chrono::milliseconds idleTime{60000};    ///< between two requests
    std::chrono::milliseconds answerTime{60000};  ///< until an answer, or 64 KiB of a long one, is taken
    std::size_t connections = 2000;
    std::size_t connectionsPerAddress = 200;
};

}  // namespace ktr::server
