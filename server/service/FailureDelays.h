#pragma once

#include <chrono>
#include <cstddef>
#include <map>
#include <mutex>
#include <string>

namespace ktr::server {

/// How long an address has to wait for the answer to wrong credentials: longer with every failure, and forgotten after
/// a while. Right credentials never wait: to lock somebody out would be a weapon. Any thread.
class FailureDelays {
  public:
    using Clock = std::chrono::steady_clock;
    static constexpr double kFirst = 0.25;   ///< seconds
    static constexpr double kLongest = 4.0;  ///< seconds
    static constexpr std::chrono::minutes kMemory{10};
    static constexpr std::size_t kMostAddresses = 10000;

    /// Notes a failure, and gives the seconds until its answer.
    double afterFailure(const std::string& address, Clock::time_point now);

  private:
    struct Entry {
        int failures = 0;
        Clock::time_point last;
    };
    std::mutex mutex_;
    std::map<std::string, Entry> entries_;
};

}  // namespace ktr::server
