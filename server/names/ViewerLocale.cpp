#include "server/names/ViewerLocale.h"

#include <algorithm>
#include <string_view>

namespace ktr::server {

namespace {

constexpr std::size_t kLongestTag = 35;

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

std::string textIn(const platform::Dictionary& context, const char* name) {
    const platform::Value* value = context.find(name);
    return value == nullptr || value->string() == nullptr ? std::string() : *value->string();
}

}  // namespace

ViewerLocale ViewerLocale::of(const platform::Dictionary& context) {
    ViewerLocale locale{textIn(context, "locale"), textIn(context, "regionCode")};
    std::replace(locale.language.begin(), locale.language.end(), '_', '-');
    const bool isTag = locale.language.size() <= kLongestTag &&
                       std::all_of(locale.language.begin(), locale.language.end(),
                                   [](char c) { return isLetter(c) || c == '-' || (c >= '0' && c <= '9'); });
    if (!isTag) {
        locale.language.clear();
    }
    if (locale.region.size() != 2 || !std::all_of(locale.region.begin(), locale.region.end(), isLetter)) {
        locale.region.clear();
    }
    return locale;
}

}  // namespace ktr::server
