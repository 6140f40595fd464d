#pragma once

#include <optional>
#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// How the assistant is set up. Main thread; answers from memory.
class KTR_API AssistantSettings {
  public:
    virtual ~AssistantSettings();
    /// BCP 47, such as "en-GB"; none when the assistant has no language set.
    virtual std::optional<std::string> languageCode() const = 0;
    /// Whether that language is written from right to left.
    virtual bool languageIsRightToLeft() const = 0;
};

}  // namespace ktr::platform
