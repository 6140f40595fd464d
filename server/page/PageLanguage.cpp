#include "server/page/PageLanguage.h"

#include <unicode/dtptngen.h>
#include <unicode/measunit.h>
#include <unicode/numberformatter.h>
#include <unicode/plurrule.h>
#include <unicode/reldatefmt.h>
#include <unicode/smpdtfmt.h>
#include <unicode/timezone.h>
#include <unicode/uloc.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>

#include "platform/base/Format.h"
#include "platform/base/PluralText.h"
#include "platform/base/Utf8.h"
#include "server/page/PageTexts.h"

namespace ktr::server {

namespace {

constexpr const char* kIsolate = "\u2068";
constexpr const char* kEndIsolate = "\u2069";
constexpr std::size_t kLongestName = 60;
constexpr double kMilliseconds = 1000.0;
constexpr std::size_t kMostRanges = 40;

std::string utf8(const icu::UnicodeString& text) {
    std::string out;
    text.toUTF8String(out);
    return out;
}

/// As it begins a line.
std::string capitalised(icu::UnicodeString text, const icu::Locale& locale) {
    return utf8(text.toTitle(nullptr, locale, U_TITLECASE_NO_LOWERCASE | U_TITLECASE_SENTENCES));
}

bool isMarkOfDirection(char32_t c) {
    return c == 0x061C || c == 0x200E || c == 0x200F || (c >= 0x202A && c <= 0x202E) || (c >= 0x2066 && c <= 0x2069);
}

/// One of ours that serves a reader of `wanted`; empty when none does.
std::string servedBy(std::string_view wanted) {
    UErrorCode status = U_ZERO_ERROR;
    icu::Locale locale =
        icu::Locale::forLanguageTag(icu::StringPiece(wanted.data(), static_cast<int>(wanted.size())), status);
    locale.canonicalize(status);
    locale.addLikelySubtags(status);
    if (U_FAILURE(status) || std::string_view(locale.getLanguage()).empty()) {
        return "";
    }
    const std::string language = std::string_view(locale.getLanguage()) == "iw" ? "he" : locale.getLanguage();
    for (const std::string& tag : {language + "-" + locale.getScript(), language}) {
        const auto& all = PageTexts::languages();
        if (std::find(all.begin(), all.end(), tag) != all.end()) {
            return tag;
        }
    }
    return "";
}

std::string_view trimmed(std::string_view text) {
    const auto begin = text.find_first_not_of(" \t");
    return begin == std::string_view::npos ? "" : text.substr(begin, text.find_last_not_of(" \t") - begin + 1);
}

}  // namespace

struct PageLanguage::Formats {
    icu::Locale locale;
    std::unique_ptr<icu::TimeZone> zone;
    std::unique_ptr<icu::PluralRules> plurals;
    std::unique_ptr<icu::RelativeDateTimeFormatter> ages;
    std::unique_ptr<icu::DateTimePatternGenerator> patterns;

    std::string date(const char* skeleton, std::int64_t time) const {
        UErrorCode status = U_ZERO_ERROR;
        const icu::UnicodeString pattern = patterns->getBestPattern(icu::UnicodeString(skeleton), status);
        icu::SimpleDateFormat format(pattern, locale, status);
        if (U_FAILURE(status)) {
            return "";
        }
        format.setTimeZone(*zone);
        icu::UnicodeString out;
        return utf8(format.format(static_cast<double>(time) * kMilliseconds, out));
    }
    /// Days since the epoch, in the reader's zone.
    std::int64_t dayNumber(std::int64_t time) const {
        UErrorCode status = U_ZERO_ERROR;
        std::int32_t raw = 0;
        std::int32_t summer = 0;
        zone->getOffset(static_cast<double>(time) * kMilliseconds, false, raw, summer, status);
        const double local = static_cast<double>(time) + static_cast<double>(raw + summer) / kMilliseconds;
        return static_cast<std::int64_t>(std::floor(local / 86400.0));
    }
    std::string measure(double value, const icu::MeasureUnit& unit, UNumberUnitWidth width) const {
        UErrorCode status = U_ZERO_ERROR;
        const auto formatted = icu::number::NumberFormatter::withLocale(locale)
                                   .unit(unit)
                                   .unitWidth(width)
                                   .precision(icu::number::Precision::maxFraction(1))
                                   .formatDouble(value, status);
        return U_FAILURE(status) ? "" : utf8(formatted.toString(status));
    }
};

PageLanguage::PageLanguage(const std::string& language, const std::string& zone)
    : tag_(language), zone_(isZone(zone) ? zone : "UTC"), formats_(std::make_unique<Formats>()) {
    UErrorCode status = U_ZERO_ERROR;
    formats_->locale = icu::Locale::forLanguageTag(tag_, status);
    formats_->zone.reset(icu::TimeZone::createTimeZone(icu::UnicodeString::fromUTF8(zone_)));
    formats_->plurals.reset(icu::PluralRules::forLocale(formats_->locale, status));
    formats_->ages = std::make_unique<icu::RelativeDateTimeFormatter>(formats_->locale, nullptr, UDAT_STYLE_SHORT,
                                                                      UDISPCTX_CAPITALIZATION_NONE, status);
    formats_->patterns.reset(icu::DateTimePatternGenerator::createInstance(formats_->locale, status));
}

PageLanguage::~PageLanguage() = default;

std::string PageLanguage::choose(std::string_view chosen, std::string_view accepted) {
    if (std::string tag = chosen.empty() ? "" : servedBy(chosen); !tag.empty()) {
        return tag;
    }
    std::string best = "en";
    double bestWeight = 0.0;
    for (std::size_t ranges = 0; !accepted.empty() && ranges < kMostRanges; ++ranges) {
        const std::size_t end = accepted.find(',');
        const std::string_view range = accepted.substr(0, end);
        accepted = end == std::string_view::npos ? std::string_view() : accepted.substr(end + 1);
        const std::size_t semicolon = range.find(';');
        const std::string tag = servedBy(trimmed(range.substr(0, semicolon)));
        double weight = 1.0;
        if (semicolon != std::string_view::npos) {
            const std::string_view parameter = trimmed(range.substr(semicolon + 1));
            weight = parameter.starts_with("q=") ? std::strtod(std::string(parameter.substr(2)).c_str(), nullptr) : 0.0;
        }
        if (!tag.empty() && weight > bestWeight && weight <= 1.0) {
            best = tag;
            bestWeight = weight;
        }
    }
    return best;
}

std::string PageLanguage::ownName(const std::string& language) {
    UErrorCode status = U_ZERO_ERROR;
    const icu::Locale locale = icu::Locale::forLanguageTag(language, status);
    icu::UnicodeString name;
    locale.getDisplayName(locale, name);
    return capitalised(name, locale);
}

bool PageLanguage::isZone(const std::string& name) {
    const std::unique_ptr<icu::TimeZone> zone(icu::TimeZone::createTimeZone(icu::UnicodeString::fromUTF8(name)));
    return !name.empty() && *zone != icu::TimeZone::getUnknown();
}

std::vector<std::string> PageLanguage::zones() {
    UErrorCode status = U_ZERO_ERROR;
    std::unique_ptr<icu::StringEnumeration> found(
        icu::TimeZone::createTimeZoneIDEnumeration(UCAL_ZONE_TYPE_CANONICAL_LOCATION, nullptr, nullptr, status));
    std::vector<std::string> names{"UTC"};
    while (U_SUCCESS(status)) {
        const char* name = found->next(nullptr, status);
        if (name == nullptr) {
            break;
        }
        names.emplace_back(name);
    }
    std::sort(names.begin(), names.end());
    return names;
}

bool PageLanguage::isRightToLeft() const {
    return formats_->locale.isRightToLeft() != 0;
}

std::string PageLanguage::text(std::string_view key, std::initializer_list<std::string> arguments) const {
    platform::FormatArguments isolated;
    for (const std::string& argument : arguments) {
        isolated.emplace_back(kIsolate + argument + kEndIsolate);
    }
    return platform::formatted(PageTexts::find(tag_, key), isolated);
}

std::string PageLanguage::plural(std::string_view key, std::int64_t number, const std::string& words) const {
    const std::string_view text = PageTexts::find(tag_, key);
    std::string category;
    formats_->plurals->select(static_cast<double>(number)).toUTF8String(category);
    return platform::formatted(platform::PluralText::branch(text, category).value_or(text),
                               {words.empty() ? this->number(number) : words});
}

std::string PageLanguage::number(std::int64_t value) const {
    UErrorCode status = U_ZERO_ERROR;
    const auto formatted = icu::number::NumberFormatter::withLocale(formats_->locale).formatInt(value, status);
    return utf8(formatted.toString(status));
}

std::string PageLanguage::clock(std::int64_t time) const {
    return formats_->date("jmm", time);
}

std::string PageLanguage::day(std::int64_t time, std::int64_t now) const {
    const std::int64_t before = formats_->dayNumber(now) - formats_->dayNumber(time);
    if (before >= -1 && before <= 1) {
        UErrorCode status = U_ZERO_ERROR;
        icu::UnicodeString out;
        const auto direction = before == 0  ? UDAT_DIRECTION_THIS
                               : before < 0 ? UDAT_DIRECTION_NEXT
                                            : UDAT_DIRECTION_LAST;
        formats_->ages->format(direction, UDAT_ABSOLUTE_DAY, out, status);
        return capitalised(out, formats_->locale);
    }
    return formats_->date("dMMM", time);
}

std::string PageLanguage::moment(std::int64_t time, std::int64_t now) const {
    UErrorCode status = U_ZERO_ERROR;
    icu::UnicodeString out;
    formats_->ages->combineDateAndTime(icu::UnicodeString::fromUTF8(day(time, now)),
                                       icu::UnicodeString::fromUTF8(clock(time)), out, status);
    return utf8(out);
}

std::string PageLanguage::age(std::int64_t seconds) const {
    UErrorCode status = U_ZERO_ERROR;
    icu::UnicodeString out;
    if (seconds < 60) {
        formats_->ages->format(UDAT_DIRECTION_PLAIN, UDAT_ABSOLUTE_NOW, out, status);
    } else {
        const auto unit = seconds < 3600 ? UDAT_RELATIVE_MINUTES : UDAT_RELATIVE_HOURS;
        const std::int64_t count = seconds / (seconds < 3600 ? 60 : 3600);
        formats_->ages->format(static_cast<double>(count), UDAT_DIRECTION_LAST, unit, out, status);
    }
    return capitalised(out, formats_->locale);
}

std::string PageLanguage::metres(double metres) const {
    return metres < 950.0 ? formats_->measure(std::ceil(metres), icu::MeasureUnit::getMeter(), UNUM_UNIT_WIDTH_SHORT)
                          : formats_->measure(metres / 1000.0, icu::MeasureUnit::getKilometer(), UNUM_UNIT_WIDTH_SHORT);
}

std::string PageLanguage::coordinates(double latitude, double longitude, bool exact) const {
    UErrorCode status = U_ZERO_ERROR;
    const auto degrees = [&](double value, const char* positive, const char* negative) {
        const std::string number = utf8(icu::number::NumberFormatter::withLocale(formats_->locale)
                                            .precision(icu::number::Precision::fixedFraction(exact ? 4 : 2))
                                            .formatDouble(std::abs(value), status)
                                            .toString(status));
        std::string words = text(value < 0.0 ? negative : positive, {number});
        // A line ends between the two and in neither.
        for (auto at = words.find(' '); at != std::string::npos; at = words.find(' ', at)) {
            words.replace(at, 1, "\u00a0");
        }
        return words;
    };
    const std::string north = degrees(latitude, "DEGREES_NORTH", "DEGREES_SOUTH");
    const std::string all = text("COORDINATES", {north, degrees(longitude, "DEGREES_EAST", "DEGREES_WEST")});
    return U_FAILURE(status) ? "" : all;
}

std::string PageLanguage::hours(std::int64_t count) const {
    return formats_->measure(static_cast<double>(count), icu::MeasureUnit::getHour(), UNUM_UNIT_WIDTH_FULL_NAME);
}

std::string PageLanguage::days(std::int64_t count) const {
    return formats_->measure(static_cast<double>(count), icu::MeasureUnit::getDay(), UNUM_UNIT_WIDTH_FULL_NAME);
}

std::string PageLanguage::fieldTime(std::int64_t time) const {
    UErrorCode status = U_ZERO_ERROR;
    icu::SimpleDateFormat format(icu::UnicodeString("HH:mm"), icu::Locale::getRoot(), status);
    format.setTimeZone(*formats_->zone);
    icu::UnicodeString out;
    return utf8(format.format(static_cast<double>(time) * kMilliseconds, out));
}

std::string shownName(std::string_view name) {
    std::string out;
    std::size_t letters = 0;
    for (std::size_t at = 0; at < name.size();) {
        const platform::Utf8Step step = platform::decodeUtf8(name, at);
        at += step.length;
        if (isMarkOfDirection(step.codePoint)) {
            continue;
        }
        if (++letters > kLongestName) {
            return out + "\u2026";
        }
        platform::appendUtf8(out, step.codePoint < 0x20 || step.codePoint == 0x7F ? U' ' : step.codePoint);
    }
    return out;
}

}  // namespace ktr::server
