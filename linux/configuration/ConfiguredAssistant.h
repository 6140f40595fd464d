#pragma once

#include <optional>
#include <string>

#include "platform/assistant/AssistantSettings.h"

namespace ktr::linux_ {

/// An assistant whose language is given: by the command line, a scenario or the session. Main thread.
class ConfiguredAssistant : public platform::AssistantSettings {
  public:
    /// BCP 47; none when no language is set.
    explicit ConfiguredAssistant(std::optional<std::string> languageCode);
    std::optional<std::string> languageCode() const override { return languageCode_; }
    /// By the script that the language is usually written in, or that its tag names. False without a language.
    bool languageIsRightToLeft() const override { return rightToLeft_; }

  private:
    std::optional<std::string> languageCode_;
    /// Every label asks at every layout, and reading a tag takes a microsecond.
    bool rightToLeft_;
};

}  // namespace ktr::linux_
