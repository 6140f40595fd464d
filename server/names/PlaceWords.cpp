#include "server/names/PlaceWords.h"

#include <unicode/locid.h>
#include <unicode/numberformatter.h>
#include <unicode/numsys.h>

#include <cmath>
#include <string_view>

#include "platform/base/Format.h"
#include "platform/base/Utf8.h"
#include "server/page/PageLanguage.h"
#include "server/page/PageTexts.h"

namespace ktr::server {

namespace {

constexpr std::string_view kIsolate = "\u2068";
constexpr std::string_view kEndIsolate = "\u2069";
constexpr std::string_view kNoBreakSpace = "\u00a0";

/// How short a unit stands in a row, as clients have it.
UNumberUnitWidth widthIn(const icu::Locale& locale) {
    const std::string_view language = locale.getLanguage();
    // In Arabic the short form spells the unit out, in Persian it is in Latin letters.
    return language == "ar"   ? UNUM_UNIT_WIDTH_NARROW
           : language == "fa" ? UNUM_UNIT_WIDTH_FULL_NAME
                              : UNUM_UNIT_WIDTH_SHORT;
}

/// The language with the digits that it has in the region: those of the other numbers in the row.
icu::Locale withDigitsOf(icu::Locale language, const std::string& region) {
    if (region.empty()) {
        return language;
    }
    UErrorCode status = U_ZERO_ERROR;
    const std::string script = language.getScript();
    const icu::Locale both((language.getLanguage() + (script.empty() ? "" : "_" + script)).c_str(), region.c_str());
    const std::unique_ptr<icu::NumberingSystem> digits(icu::NumberingSystem::createInstance(both, status));
    if (U_SUCCESS(status)) {
        language.setUnicodeKeywordValue("nu", digits->getName(), status);
    }
    return language;
}

std::string utf8(const icu::number::FormattedNumber& number, UErrorCode& status) {
    std::string out;
    number.toString(status).toUTF8String(out);
    return U_FAILURE(status) ? "" : out;
}

}  // namespace

struct PlaceWords::Formats {
    icu::Locale locale;
    icu::number::LocalizedNumberFormatter road;
    icu::number::LocalizedNumberFormatter hundredths;
};

PlaceWords::PlaceWords(const ViewerLocale& locale)
    : tag_(PageLanguage::choose(locale.language, "")), formats_(std::make_unique<Formats>()) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::Locale wanted = icu::Locale::forLanguageTag(locale.language, status);
    const icu::Locale served = icu::Locale::forLanguageTag(tag_, status);
    const bool isServed = std::string_view(wanted.getLanguage()) == served.getLanguage();
    language_ = isServed ? locale.language : tag_;
    formats_->locale = withDigitsOf(isServed ? wanted : served, locale.region);
    icu::Locale roads = formats_->locale;
    if (!locale.region.empty()) {
        roads.setUnicodeKeywordValue("rg", platform::asciiLowercased(locale.region) + "zzzz", status);
    }
    formats_->road = icu::number::NumberFormatter::forSkeleton(u"unit/meter usage/road", status)
                         .unitWidth(widthIn(formats_->locale))
                         .locale(roads);
    formats_->hundredths =
        icu::number::NumberFormatter::withLocale(formats_->locale).precision(icu::number::Precision::fixedFraction(2));
}

PlaceWords::~PlaceWords() = default;

std::string PlaceWords::text(const char* key, std::initializer_list<std::string> arguments) const {
    // Where a line runs from right to left, a name in other letters must not turn the rest around.
    const bool isolates = formats_->locale.isRightToLeft() != 0;
    platform::FormatArguments given;
    for (const std::string& argument : arguments) {
        given.emplace_back(isolates ? std::string(kIsolate) + argument + std::string(kEndIsolate) : argument);
    }
    return platform::formatted(PageTexts::find(tag_, key), given);
}

std::string PlaceWords::street(const std::string& street, const std::string& town) const {
    return town.empty() ? street : text("STREET_IN_TOWN", {street, town});
}

std::string PlaceWords::near(const std::string& town, double metres) const {
    return text("NEAR_TOWN", {town, distance(metres)});
}

std::string PlaceWords::distance(double metres) const {
    UErrorCode status = U_ZERO_ERROR;
    std::string out = utf8(formats_->road.formatDouble(metres, status), status);
    for (auto at = out.find(' '); at != std::string::npos; at = out.find(' ', at)) {
        out.replace(at, 1, kNoBreakSpace);
    }
    return out;
}

std::string PlaceWords::degrees(double value, const char* positive, const char* negative) const {
    UErrorCode status = U_ZERO_ERROR;
    const double rounded = std::round(value * 100.0) / 100.0;
    return platform::formatted(PageTexts::find(tag_, rounded < 0.0 ? negative : positive),
                               {utf8(formats_->hundredths.formatDouble(std::abs(rounded), status), status)});
}

std::string PlaceWords::coordinates(double latitude, double longitude) const {
    return text("COORDINATES", {degrees(latitude, "DEGREES_NORTH", "DEGREES_SOUTH"),
                                degrees(longitude, "DEGREES_EAST", "DEGREES_WEST")});
}

}  // namespace ktr::server
