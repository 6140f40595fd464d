#pragma once

#include <memory>
#include <variant>
#include <vector>

#include "platform/assistant/VALocation.h"
#include "platform/base/Value.h"

namespace ktr {

class KTRVAMyLocation;

/// One thing that a command found: a friend's location, the raw answer, or the user's own record.
using ResultItem =
    std::variant<std::shared_ptr<platform::VAKtrLocation>, platform::Dictionary, std::shared_ptr<KTRVAMyLocation>>;

/// What a command found, in the service's order.
using ServiceResult = std::vector<ResultItem>;

}  // namespace ktr
