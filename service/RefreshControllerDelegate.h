#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/assistant/VAPerson.h"
#include "service/ServiceResult.h"

namespace ktr {

/// Gives a refresh controller what its requests say, and hears what comes of them. Main thread.
class RefreshControllerDelegate {
  public:
    virtual ~RefreshControllerDelegate() = default;
    /// The service's identifier of the conversation; may be none.
    virtual std::optional<std::string> clientId() const = 0;
    /// Whose locations are asked for.
    virtual std::vector<std::shared_ptr<platform::VAPerson>> friends() const = 0;
    virtual std::optional<std::string> proximity() const = 0;
    /// A successful answer. Never none; empty when the answer held nothing.
    virtual void locationsUpdated(const std::shared_ptr<const ServiceResult>& result) = 0;
    /// Refreshing has ended. It can be said more than once.
    virtual void refreshCancelled() = 0;
};

}  // namespace ktr
