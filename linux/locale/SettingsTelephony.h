#pragma once

#include <optional>
#include <string>
#include <utility>

#include "platform/contacts/PhoneNumberLibrary.h"

namespace ktr::linux_ {

/// The home country from the settings or a scenario. Main thread.
class SettingsTelephony : public platform::Telephony {
  public:
    /// Two letters in either case, handed on as they stand; none, or anything but two ASCII letters: no home country.
    explicit SettingsTelephony(std::optional<std::string> homeCountryCode);
    std::optional<std::string> homeCountryCode() const override { return homeCountryCode_; }

  private:
    std::optional<std::string> homeCountryCode_;
};

}  // namespace ktr::linux_
