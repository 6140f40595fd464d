#include "linux/net/TroubleLine.h"

#include <algorithm>

namespace ktr::linux_ {

void TroubleLine::say(const std::string& host, const std::string& reason) {
    constexpr std::size_t kMostHosts = 16;
    if (std::find(said_.begin(), said_.end(), std::pair(host, reason)) != said_.end()) {
        return;
    }
    clear(host);
    if (said_.size() >= kMostHosts) {
        said_.erase(said_.begin());
    }
    said_.emplace_back(host, reason);
    platform::areaLog(area_).write(platform::LogLevel::Error, format_, host, platform::FormatArgument(reason).shown());
}

void TroubleLine::clear(const std::string& host) {
    std::erase_if(said_, [&host](const auto& said) { return said.first == host; });
}

}  // namespace ktr::linux_
