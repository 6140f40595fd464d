#pragma once

#include <atomic>
#include <cstdint>
#include <string>

namespace ktr::server {

/// What became of connections, in numbers. Any thread.
struct EdgeCounters {
    std::atomic<std::int64_t> accepted = 0;    ///< connections let in
    std::atomic<std::int64_t> turnedAway = 0;  ///< connections for which there was no room
    std::atomic<std::int64_t> gaveWay = 0;     ///< connections closed to make room
    std::atomic<std::int64_t> outOfTime = 0;   ///< connections closed at a deadline
    std::atomic<std::int64_t> refusedRequests =
        0;  ///< requests that two readers could understand differently, or too long

    /// In the text format of Prometheus.
    std::string text() const;
};

}  // namespace ktr::server
