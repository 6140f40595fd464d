#include "linux/locale/IcuLengthFormatter.h"

#include <string_view>
#include <utility>

#include <unicode/locid.h>
#include <unicode/numberformatter.h>

#include "linux/locale/UnitWidth.h"
#include "platform/base/Json.h"

namespace ktr::linux_ {

namespace {

icu::MeasureUnit unitOf(platform::LengthUnit unit) {
    switch (unit) {
        case platform::LengthUnit::Meter:
            return icu::MeasureUnit::getMeter();
        case platform::LengthUnit::Kilometer:
            return icu::MeasureUnit::getKilometer();
        case platform::LengthUnit::Foot:
            return icu::MeasureUnit::getFoot();
        case platform::LengthUnit::Yard:
            return icu::MeasureUnit::getYard();
        case platform::LengthUnit::Mile:
            return icu::MeasureUnit::getMile();
    }
    return icu::MeasureUnit::getMeter();
}

void keepTogether(std::string& text) {
    constexpr std::string_view kNoBreakSpace = "\u00a0";
    for (auto at = text.find(' '); at != std::string::npos; at = text.find(' ', at)) {
        text.replace(at, 1, kNoBreakSpace);
    }
}

}  // namespace

IcuLengthFormatter::IcuLengthFormatter(std::string language, platform::LengthSystem system)
    : language_(std::move(language)), system_(system) {}

std::string IcuLengthFormatter::text(double amount, platform::LengthUnit unit, platform::LengthWidth width) const {
    UErrorCode status = U_ZERO_ERROR;
    auto locale = icu::Locale::forLanguageTag(language_, status);
    if (U_FAILURE(status) || locale.isBogus()) {
        locale = icu::Locale::getRoot();
        status = U_ZERO_ERROR;
    }
    const bool isShort = width == platform::LengthWidth::Short;
    const auto unitWidth = isShort ? UnitWidth::inRow(locale) : UNUM_UNIT_WIDTH_FULL_NAME;
    const auto formatter = icu::number::NumberFormatter::withLocale(locale)
                               .unit(unitOf(unit))
                               .unitWidth(unitWidth)
                               .precision(icu::number::Precision::maxFraction(1));
    std::string text;
    formatter.formatDouble(amount, status).toString(status).toUTF8String(text);
    if (U_FAILURE(status)) {
        return platform::writeJsonNumber(amount);
    }
    if (isShort) {
        keepTogether(text);
    }
    return text;
}

}  // namespace ktr::linux_
