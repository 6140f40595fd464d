#pragma once

#include <string>

#include "platform/base/Region.h"
#include "platform/contacts/PhoneNumberLibrary.h"

namespace ktr::linux_ {

/// The country whose phone numbers are written without a country code. Main thread.
struct HomeCountry {
    /// The telephony's, else the locale's, else the United States, as the plugin has it: a number in the contacts and
    /// the same number in an answer have to be read alike, also in a session without a country (C.UTF-8). Lower case.
    static std::string of(const platform::Telephony& telephony, const platform::RegionSettings& region);
};

}  // namespace ktr::linux_
