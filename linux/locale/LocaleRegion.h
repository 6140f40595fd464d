#pragma once

#include <optional>
#include <string>
#include <utility>

#include "platform/base/Region.h"

namespace ktr::linux_ {

/// The region that a locale names. Main thread.
class LocaleRegion : public platform::RegionSettings {
  public:
    /// BCP 47 ("de-CH") or POSIX ("de_CH.UTF-8").
    explicit LocaleRegion(const std::string& locale);
    std::string localeIdentifier() const override { return identifier_; }
    std::optional<std::string> countryCode() const override { return country_; }

    /// The locale of a language in this region, such as "ar-GB" for Arabic ("ar-EG") in the United Kingdom: numbers
    /// look as the language writes them, with what the region does to it. Without a country, or a language that can be
    /// read: the language as given, or this locale.
    std::string localeWithLanguage(const std::string& language) const;

    /// The session's locale for measures, as BCP 47: the first of LC_ALL, LC_MEASUREMENT, LANG that is set; "en" for
    /// none and for the C locale.
    static std::string sessionLocale();
    /// The session's language, as BCP 47: the first of LC_ALL, LC_MESSAGES, LANG that is set; "en" likewise.
    static std::string sessionLanguage();

  private:
    std::string identifier_;
    std::optional<std::string> country_;
};

}  // namespace ktr::linux_
