#pragma once

#include <atomic>
#include <cstdint>
#include <string>

namespace ktr::server {

/// What the service did, in numbers without people in them. Any thread.
struct ServiceCounters {
    std::atomic<std::int64_t> posts = 0;             ///< of phones, with right credentials
    std::atomic<std::int64_t> fixes = 0;             ///< handed to the store
    std::atomic<std::int64_t> junk = 0;              ///< posts that were not understood
    std::atomic<std::int64_t> droppedNoPlace = 0;    ///< positions that are no place on earth
    std::atomic<std::int64_t> droppedNoTime = 0;     ///< positions without a time
    std::atomic<std::int64_t> droppedTooOld = 0;     ///< positions beyond the retention
    std::atomic<std::int64_t> droppedFaces = 0;      ///< pictures that are no faces
    std::atomic<std::int64_t> commands = 0;          ///< of readers, with right credentials
    std::atomic<std::int64_t> wrongCredentials = 0;  ///< refused
    std::atomic<std::int64_t> storeFailures = 0;     ///< answers that could not be given

    /// In the text format of Prometheus.
    std::string text() const;
};

}  // namespace ktr::server
