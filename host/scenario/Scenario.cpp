#include "host/scenario/Scenario.h"

#include <algorithm>
#include <cctype>

#include "platform/base/Utf8.h"

namespace ktr::host {

namespace {

std::string primaryLanguage(const std::string& language) {
    return platform::asciiLowercased(language.substr(0, language.find('-')));
}

}  // namespace

std::string LocalizedText::text(const std::string& language) const {
    const auto firstWhere = [this](auto matches) -> const std::string* {
        const auto found = std::find_if(texts_.begin(), texts_.end(), [&](const auto& t) { return matches(t.first); });
        return found == texts_.end() ? nullptr : &found->second;
    };
    const std::string wanted = platform::asciiLowercased(language);
    if (const auto* exact = firstWhere([&](const auto& l) { return platform::asciiLowercased(l) == wanted; })) {
        return *exact;
    }
    for (const std::string& primary : {primaryLanguage(language), std::string("en")}) {
        if (const auto* near = firstWhere([&](const auto& l) { return primaryLanguage(l) == primary; })) {
            return *near;
        }
    }
    return texts_.empty() ? "" : texts_.front().second;
}

bool isLanguageTag(const std::string& text) {
    std::size_t group = 0;
    for (const char c : text) {
        if (c == '-') {
            if (group == 0) {
                return false;
            }
            group = 0;
        } else if (std::isalnum(static_cast<unsigned char>(c)) == 0 || ++group > 8) {
            return false;
        }
    }
    return group > 0 && std::isalpha(static_cast<unsigned char>(text.front())) != 0;
}

}  // namespace ktr::host
