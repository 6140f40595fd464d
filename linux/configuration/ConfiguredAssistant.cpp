#include "linux/configuration/ConfiguredAssistant.h"

#include <unicode/locid.h>

#include <utility>

namespace ktr::linux_ {

namespace {

bool isRightToLeft(const std::optional<std::string>& languageCode) {
    if (!languageCode) {
        return false;
    }
    UErrorCode status = U_ZERO_ERROR;
    const auto locale = icu::Locale::forLanguageTag(*languageCode, status);
    return U_SUCCESS(status) && locale.isRightToLeft();
}

}  // namespace

ConfiguredAssistant::ConfiguredAssistant(std::optional<std::string> languageCode)
    : languageCode_(std::move(languageCode)), rightToLeft_(isRightToLeft(languageCode_)) {}

}  // namespace ktr::linux_
