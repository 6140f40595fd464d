#include "model/LabelUtil.h"

#include <algorithm>
#include <string_view>

#include "platform/assistant/Localization.h"
#include "platform/base/Platform.h"
#include "platform/base/Utf8.h"

namespace ktr {

const std::vector<std::string>& LabelUtil::defaultLabelKeys() {
    static const std::vector<std::string> keys = {"_$!<home>!$_", "_$!<work>!$_", "_$!<school>!$_", "_$!<gym>!$_",
                                                  "_$!<other>!$_"};
    return keys;
}

bool LabelUtil::isDefaultLabel(const std::optional<std::string>& label) {
    // Most labels, and every city, are somebody's own words.
    constexpr std::string_view kOpening = "_$!<";
    const auto& keys = defaultLabelKeys();
    return label && label->starts_with(kOpening) &&
           std::find(keys.begin(), keys.end(), platform::asciiLowercased(*label)) != keys.end();
}

std::optional<std::string> LabelUtil::keyForDefaultLabel(const std::string& text) {
    const auto localization = platform::Platform::installed()->localization;
    for (const std::string& key : defaultLabelKeys()) {
        if (localization->text(key, localization->hostBundleIdentifier(), std::nullopt, "") == text) {
            return key;
        }
    }
    return std::nullopt;
}

}  // namespace ktr
