#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/base/Api.h"

namespace ktr::platform {

/// The user's region. Main thread; answers from memory.
class KTR_API RegionSettings {
  public:
    virtual ~RegionSettings();
    /// The current locale's identifier (BCP 47), such as "de-CH".
    virtual std::string localeIdentifier() const = 0;
    /// Two letters in upper case (ISO 3166-1); none for a locale without a country.
    virtual std::optional<std::string> countryCode() const = 0;
};

/// Numbers as the user writes them. Main thread.
class KTR_API NumberFormatter {
  public:
    virtual ~NumberFormatter();
    /// The locale's decimal style; none for a text that is not wholly a number.
    virtual std::optional<double> numberFromString(const std::string& text) const = 0;
    /// The locale's plain style: no grouping, no fraction digits, the language's own digits.
    virtual std::string plainStringFromInteger(std::int64_t number) const = 0;
};

}  // namespace ktr::platform
