#pragma once

#include <optional>
#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// Localized texts of bundles, by key. Main thread; answers from memory.
class KTR_API Localization {
  public:
    virtual ~Localization();
    /// The text in the assistant's language, else in English; else `defaultValue`; else the key itself. A table of none
    /// is the bundle's default one. The host's own bundle is `hostBundleIdentifier`.
    virtual std::string text(const std::string& key, const std::string& bundleIdentifier,
                             const std::optional<std::string>& table = std::nullopt,
                             const std::optional<std::string>& defaultValue = std::nullopt) const = 0;
    virtual std::string hostBundleIdentifier() const = 0;
    /// The language that the texts are in (BCP 47), whose rules plural texts follow: English where there are none in
    /// the language that was asked for. Any thread.
    virtual std::string languageOfTexts() const { return "en"; }
};

}  // namespace ktr::platform
