#pragma once

#include <string>

#include "platform/base/Object.h"

namespace ktr::platform {

/// The identifier of the plugin that comes with this project: of its manifest, its texts and images, its log and its
/// preferences.
inline constexpr const char* kSnippetsBundle = "org.ktr.snippets";

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
