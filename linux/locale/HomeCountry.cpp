#include "linux/locale/HomeCountry.h"

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

std::string HomeCountry::of(const platform::Telephony& telephony, const platform::RegionSettings& region) {
    auto code = telephony.homeCountryCode();
    if (!code) {
        code = region.countryCode();
    }
    return platform::asciiLowercased(code.value_or("us"));
}

}  // namespace ktr::linux_
