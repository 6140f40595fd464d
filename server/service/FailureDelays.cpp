#include "server/service/FailureDelays.h"

#include <algorithm>
#include <cmath>
#include <iterator>

namespace ktr::server {

double FailureDelays::afterFailure(const std::string& address, Clock::time_point now) {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (entries_.size() >= kMostAddresses) {
        for (auto entry = entries_.begin(); entry != entries_.end();) {
            entry = now - entry->second.last > kMemory ? entries_.erase(entry) : std::next(entry);
        }
        if (entries_.size() >= kMostAddresses) {
            return kLongest;
        }
    }
    Entry& entry = entries_[address];
    entry.failures = now - entry.last > kMemory ? 1 : entry.failures + 1;
    entry.last = now;
    return std::min(kLongest, kFirst * std::pow(2.0, std::min(entry.failures, 10) - 1));
}

}  // namespace ktr::server
