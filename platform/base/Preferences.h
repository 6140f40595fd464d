#pragma once

#include <optional>
#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// Small settings that outlive the process: texts by key, in named domains (reverse-domain names). Any thread; reading
/// and writing work in memory, `synchronize` asks for the disk.
class KTR_API Preferences {
  public:
    virtual ~Preferences();
    /// None when nothing is stored.
    virtual std::optional<std::string> value(const std::string& key, const std::string& domain) const = 0;
    /// None removes. Seen by the next `value` at once.
    virtual void setValue(const std::string& key, const std::optional<std::string>& value,
                          const std::string& domain) = 0;
    /// Brings the domain's changes to the disk, and what other processes wrote there into memory. It may do so after
    /// returning. A failure is logged; the values stay in memory.
    virtual void synchronize(const std::string& domain) = 0;
};

}  // namespace ktr::platform
