#include "linux/services/ConfiguredAssistant.h"

#include <unicode/locid.h>

namespace ktr::linux_ {

bool ConfiguredAssistant::languageIsRightToLeft() const {
    if (!languageCode_) {
        return false;
    }
    UErrorCode status = U_ZERO_ERROR;
    const auto locale = icu::Locale::forLanguageTag(*languageCode_, status);
    return U_SUCCESS(status) && locale.isRightToLeft();
}

}  // namespace ktr::linux_
