#pragma once

#include <memory>

#include "platform/assistant/VASnippet.h"
#include "service/ServiceResult.h"

namespace ktr::test {

/// What a command hands on that found these friends.
inline std::shared_ptr<const ServiceResult> resultOf(const std::shared_ptr<const platform::LocationList>& locations) {
    return std::make_shared<const ServiceResult>(locations->begin(), locations->end());
}

}  // namespace ktr::test
