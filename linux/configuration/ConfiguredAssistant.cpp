#include "linux/configuration/ConfiguredAssistant.h"

#include <unicode/locid.h>

#include <string_view>
#include <utility>

namespace ktr::linux_ {

namespace {

/// The variant of the pseudo-language that is written from right to left (docs/translating.md).
constexpr std::string_view kMirrored = "PLOCM";

bool isRightToLeft(const std::optional<std::string>& languageCode) {
    if (!languageCode) {
        return false;
    }
    UErrorCode status = U_ZERO_ERROR;
    const auto locale = icu::Locale::forLanguageTag(*languageCode, status);
    return U_SUCCESS(status) && (locale.isRightToLeft() || locale.getVariant() == kMirrored);
}

}  // namespace

ConfiguredAssistant::ConfiguredAssistant(std::optional<std::string> languageCode)
    : languageCode_(std::move(languageCode)), rightToLeft_(isRightToLeft(languageCode_)) {}

}  // namespace ktr::linux_
