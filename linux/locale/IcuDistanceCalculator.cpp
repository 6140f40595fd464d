#include "linux/locale/IcuDistanceCalculator.h"

#include <cmath>
#include <functional>
#include <string_view>
#include <utility>

#include <unicode/locid.h>
#include <unicode/numberformatter.h>
#include <unicode/numsys.h>
#include <unicode/ulocdata.h>

#include "linux/locale/LocaleRegion.h"
#include "linux/locale/UnitWidth.h"
#include "platform/base/Format.h"

namespace ktr::linux_ {

namespace {

constexpr const char* kFrameKey = "DISTANCE_TEXT";
constexpr std::string_view kNoBreakSpace = "\u00a0";

/// A friend who walks towards the user should be seen to come nearer: tens where road signs count in fifties.
constexpr double kStep = 10.0;
constexpr double kLeastInTens = 10.0;

/// Of all friends of a long list, some 100 bytes each.
constexpr std::size_t kMostKnown = 16384;
/// An odd number without a pattern (2^64 divided by the golden ratio).
constexpr std::size_t kHashFactor = 0x9E3779B97F4A7C15U;

/// The units of short distances.
bool isShortUnit(const icu::MeasureUnit& unit) {
    const std::string_view name = unit.getIdentifier();
    return name == "meter" || name == "yard" || name == "foot";
}

icu::Locale localeOf(const std::string& tag) {
    UErrorCode status = U_ZERO_ERROR;
    auto locale = icu::Locale::forLanguageTag(tag, status);
    return U_FAILURE(status) || locale.isBogus() ? icu::Locale::getRoot() : locale;
}

std::string keyword(const icu::Locale& locale, const char* name) {
    UErrorCode status = U_ZERO_ERROR;
    const auto value = locale.getUnicodeKeywordValue<std::string>(name, status);
    return U_SUCCESS(status) ? value : std::string();
}

/// What a locale says of units outright (Unicode locale keyword "ms").
std::optional<UnitSystem> explicitSystem(const icu::Locale& locale) {
    const std::string name = keyword(locale, "ms");
    if (name == "metric") {
        return UnitSystem::Metric;
    }
    if (name == "ussystem") {
        return UnitSystem::ImperialUS;
    }
    if (name == "uksystem") {
        return UnitSystem::ImperialUK;
    }
    return std::nullopt;
}

/// A region of which the system is the custom: the keyword "ms" alone does not choose the units of roads.
std::string regionOf(UnitSystem system) {
    switch (system) {
        case UnitSystem::Metric:
            return "DE";
        case UnitSystem::ImperialUS:
            return "US";
        case UnitSystem::ImperialUK:
            return "GB";
    }
    return "DE";
}

/// Two letters; empty when nothing is known.
std::string regionOf(const icu::Locale& locale) {
    const std::string overriding = keyword(locale, "rg");
    if (overriding.size() >= 2) {
        std::string region = overriding.substr(0, 2);
        for (char& c : region) {
            c = static_cast<char>(c >= 'a' && c <= 'z' ? c - 'a' + 'A' : c);
        }
        return region;
    }
    icu::Locale likely = locale;
    UErrorCode status = U_ZERO_ERROR;
    if (std::string_view(likely.getCountry()).empty()) {
        likely.addLikelySubtags(status);
    }
    return U_SUCCESS(status) ? likely.getCountry() : "";
}

UnitSystem systemOf(const std::string& region) {
    UErrorCode status = U_ZERO_ERROR;
    const auto system = ulocdata_getMeasurementSystem(("und_" + region).c_str(), &status);
    if (U_FAILURE(status)) {
        return UnitSystem::Metric;
    }
    return system == UMS_US ? UnitSystem::ImperialUS : system == UMS_UK ? UnitSystem::ImperialUK : UnitSystem::Metric;
}

icu::Locale withRegionOverride(icu::Locale language, const std::string& region) {
    UErrorCode status = U_ZERO_ERROR;
    language.setUnicodeKeywordValue("ms", nullptr, status);
    status = U_ZERO_ERROR;
    if (region.size() == 2) {
        language.setUnicodeKeywordValue("rg", region + "zzzz", status);
    }
    return language;
}

/// The language with the digits that it has in the region: those of the numbers beside the distance.
icu::Locale withDigitsOf(icu::Locale language, const std::string& region) {
    UErrorCode status = U_ZERO_ERROR;
    const auto tag = language.toLanguageTag<std::string>(status);
    const auto both = localeOf(LocaleRegion(region).localeWithLanguage(tag));
    const std::unique_ptr<icu::NumberingSystem> digits(icu::NumberingSystem::createInstance(both, status));
    if (U_SUCCESS(status)) {
        language.setUnicodeKeywordValue("nu", digits->getName(), status);
    }
    return language;
}

}  // namespace

struct IcuDistanceCalculator::Formatter {
    icu::number::LocalizedNumberFormatter road;
    /// The same in whole tens, for the units in which roads are rounded to fifties.
    icu::number::LocalizedNumberFormatter tens;
    bool usable = false;
};

IcuDistanceCalculator::IcuDistanceCalculator(Settings settings, std::optional<UnitSystem> override,
                                             std::shared_ptr<platform::Geodesy> geodesy)
    : settings_(std::move(settings)),
      system_(UnitSystem::Metric),
      geodesy_(std::move(geodesy)),
      formatter_(std::make_unique<Formatter>()) {
    const icu::Locale units = localeOf(settings_.measurementSystemLocale);
    if (!override) {
        override = explicitSystem(units);
    }
    const std::string region = override ? regionOf(*override) : regionOf(units);
    system_ = override ? *override : systemOf(region);
    const icu::Locale language =
        withDigitsOf(localeOf(settings_.languageLocale.value_or(settings_.measurementSystemLocale)),
                     settings_.measurementSystemLocale);
    UErrorCode status = U_ZERO_ERROR;
    const auto road = icu::number::NumberFormatter::forSkeleton(u"unit/meter usage/road", status)
                          .unitWidth(UnitWidth::inRow(language));
    const icu::Locale locale = withRegionOverride(language, region);
    formatter_->road = road.locale(locale);
    formatter_->tens = road.precision(icu::number::Precision::increment(kStep)).locale(locale);
    formatter_->usable = U_SUCCESS(status);
}

IcuDistanceCalculator::~IcuDistanceCalculator() = default;

std::size_t IcuDistanceCalculator::EndsHash::operator()(const Ends& ends) const {
    std::size_t hash = 0;
    for (const double part : {ends.from.latitude, ends.from.longitude, ends.to.latitude, ends.to.longitude}) {
        hash = hash * kHashFactor + std::hash<double>()(part);
    }
    return hash ^ (hash >> 32U);
}

std::optional<std::string> IcuDistanceCalculator::localizedDistance(const platform::PlatformLocation& from,
                                                                    const platform::PlatformLocation& to) {
    const Ends ends{from.coordinate(), to.coordinate()};
    if (const auto found = known_.find(ends); found != known_.end()) {
        return framed(found->second);
    }
    const std::string text = worded(geodesy_->distance(ends.from, ends.to));
    if (text.empty()) {
        return std::nullopt;
    }
    if (known_.size() == kMostKnown) {
        known_.clear();
    }
    known_.emplace(ends, text);
    return framed(text);
}

std::optional<std::string> IcuDistanceCalculator::localizedDistance(double metres) const {
    const std::string text = worded(metres);
    return text.empty() ? std::nullopt : std::optional(framed(text));
}

std::string IcuDistanceCalculator::worded(double metres) const {
    if (!formatter_->usable || !std::isfinite(metres) || metres < 0.0) {
        return {};
    }
    UErrorCode status = U_ZERO_ERROR;
    auto formatted = formatter_->road.formatDouble(metres, status);
    if (metres >= kLeastInTens && isShortUnit(formatted.getOutputUnit(status))) {
        formatted = formatter_->tens.formatDouble(metres, status);
    }
    std::string text;
    formatted.toString(status).toUTF8String(text);
    if (U_FAILURE(status)) {
        return {};
    }
    for (auto at = text.find(' '); at != std::string::npos; at = text.find(' ', at)) {
        text.replace(at, 1, kNoBreakSpace);
    }
    return text;
}

std::string IcuDistanceCalculator::framed(const std::string& text) const {
    const auto& texts = settings_.localizationDelegate;
    return texts
               ? platform::formatted(texts->text(kFrameKey, texts->hostBundleIdentifier(), std::nullopt, "%@"), {text})
               : text;
}

long IcuDistanceCalculator::measurementSystem() const {
    return static_cast<long>(system_);
}

}  // namespace ktr::linux_
