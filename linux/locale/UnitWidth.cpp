#include "linux/locale/UnitWidth.h"

#include <string_view>

namespace ktr::linux_ {

UNumberUnitWidth UnitWidth::inRow(const icu::Locale& language) {
    const std::string_view name = language.getLanguage();
    // In Arabic the short form spells the unit out and inflects it; the narrow one is the abbreviation.
    if (name == "ar") {
        return UNUM_UNIT_WIDTH_NARROW;
    }
    // In Persian the short form is in Latin letters, and the word is short.
    return name == "fa" ? UNUM_UNIT_WIDTH_FULL_NAME : UNUM_UNIT_WIDTH_SHORT;
}

}  // namespace ktr::linux_
