#pragma once

#include <string>
#include <utility>
#include <vector>

#include "platform/base/LogArea.h"

namespace ktr::linux_ {

/// Says what is wrong with a host once, in a line that is written at every level: not again until another thing is
/// wrong with it, or until nothing has been. A value of one thread.
class TroubleLine {
  public:
    /// `format` takes the host, which is private, and the reason.
    TroubleLine(platform::LogArea area, std::string format) : area_(area), format_(std::move(format)) {}

    void say(const std::string& host, const std::string& reason);
    /// Nothing is wrong with the host now.
    void clear(const std::string& host);

  private:
    platform::LogArea area_;
    std::string format_;
    /// Hosts and what was said of them; few.
    std::vector<std::pair<std::string, std::string>> said_;
};

}  // namespace ktr::linux_
