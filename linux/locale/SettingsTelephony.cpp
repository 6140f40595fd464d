#include "linux/locale/SettingsTelephony.h"

#include <algorithm>

namespace ktr::linux_ {

namespace {

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

}  // namespace

SettingsTelephony::SettingsTelephony(std::optional<std::string> homeCountryCode) {
    if (homeCountryCode && homeCountryCode->size() == 2 &&
        std::all_of(homeCountryCode->begin(), homeCountryCode->end(), isLetter)) {
        homeCountryCode_ = std::move(homeCountryCode);
    }
}

}  // namespace ktr::linux_
