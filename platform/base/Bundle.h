#pragma once

#include <string>

#include "platform/base/Object.h"

namespace ktr::platform {

/// Who a resource or an authorisation belongs to: the plugin, or the host.
class KTR_API Bundle : public Object {
  public:
    explicit Bundle(std::string identifier) : identifier_(std::move(identifier)) {}
    /// Reverse-domain, such as "org.ktr.snippets".
    const std::string& identifier() const { return identifier_; }

  private:
    std::string identifier_;
};

}  // namespace ktr::platform
