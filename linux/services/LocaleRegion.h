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
