#include "linux/locale/IcuDistanceCalculator.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>
#include <string_view>
#include <utility>
#include <vector>

#include <unicode/locid.h>
#include <unicode/numberformatter.h>
#include <unicode/numsys.h>
#include <unicode/ulocdata.h>

#include "linux/locale/LocaleRegion.h"
#include "linux/locale/UnitWidth.h"
#include "platform/base/FilledText.h"

namespace ktr::linux_ {

namespace {

constexpr const char* kFrameKey = "DISTANCE_TEXT";
/// The distance and nothing else.
constexpr const char* kPlainFrame = "%@";
constexpr std::string_view kNoBreakSpace = "\u00a0";

/// A friend who walks towards the user should be seen to come nearer: tens where road signs count in fifties.
constexpr double kStep = 10.0;
constexpr double kLeastInTens = 10.0;

/// The units of short distances.
bool isShortUnit(const icu::MeasureUnit& unit) {
    const std::string_view name = unit.getIdentifier();
    return name == "meter" || name == "yard" || name == "foot";
}

/// 0 for a unit that no region measures its roads in.
double metresIn(std::string_view unit) {
    constexpr std::array<std::pair<std::string_view, double>, 6> kUnits = {{{"meter", 1.0},
                                                                            {"kilometer", 1000.0},
                                                                            {"foot", 0.3048},
                                                                            {"yard", 0.9144},
                                                                            {"mile", 1609.344},
                                                                            {"mile-scandinavian", 10000.0}}};
    const auto* found =
        std::find_if(kUnits.begin(), kUnits.end(), [unit](const auto& known) { return known.first == unit; });
    return found == kUnits.end() ? 0.0 : found->second;
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

/// The number that is written, without its decimal point: one for all that are written alike. None where rounding goes
/// by a hair, and for what is too small or large to be worth keeping.
std::optional<std::int64_t> roundedNumber(double number, bool isInTens) {
    constexpr double kMost = 1e5;
    constexpr double kHair = 1e-6;
    if (number < 0.1 || number >= kMost) {
        return std::nullopt;
    }
    // Two digits at least: 0.57, 5.7, 57, 573.
    const int decimals = number < 1.0 ? 2 : number < 10.0 ? 1 : 0;
    const double scaled = isInTens ? number / kStep : number * (decimals == 2 ? 100.0 : decimals == 1 ? 10.0 : 1.0);
    const double whole = std::floor(scaled + 0.5);
    if (std::abs(scaled + 0.5 - std::round(scaled + 0.5)) < kHair) {
        return std::nullopt;
    }
    return static_cast<std::int64_t>(whole) * 4 + (isInTens ? 3 : decimals);
}

std::string frameIn(const std::shared_ptr<platform::Localization>& texts) {
    return texts ? texts->text(kFrameKey, texts->hostBundleIdentifier(), std::nullopt, kPlainFrame) : kPlainFrame;
}

std::string wordsOf(const icu::number::FormattedNumber& number, UErrorCode& status) {
    std::string text;
    number.toTempString(status).toUTF8String(text);
    for (auto at = text.find(' '); at != std::string::npos; at = text.find(' ', at)) {
        text.replace(at, 1, kNoBreakSpace);
    }
    return text;
}

}  // namespace

/// Asking for the unit costs four times as much as writing in one that is known. From which distance to which a unit
/// serves is learnt from the answers: units follow each other, so that what lies between two distances in one unit is
/// in it too. There are few numbers once they are rounded: each is written once.
struct IcuDistanceCalculator::Formatter {
    struct Stretch {
        std::string unit;
        double metres = 1.0;  ///< in the unit
        double from = 0.0;
        double to = 0.0;
        bool isInTens = false;
        icu::number::LocalizedNumberFormatter format;
        std::unordered_map<std::int64_t, std::string> words;  ///< by `roundedNumber`
    };

    /// The words of a distance in a unit that serves for it, or none when no such unit is known.
    std::optional<std::string> known(double metres, UErrorCode& status);
    /// The words of all distances between these two; none where there are several, or where they were never asked for.
    const std::string* known(const platform::Geodesy::Bounds& bounds) const;
    void learn(const icu::MeasureUnit& unit, double metres);

    /// Chooses the unit.
    icu::number::LocalizedNumberFormatter road;
    /// For the units in which roads are rounded to fifties: whole tens. For the others what `road` does of itself.
    icu::number::LocalizedNumberFormatter tens;
    icu::number::LocalizedNumberFormatter twoDigits;
    std::vector<Stretch> stretches;
    bool usable = false;
};

const std::string* IcuDistanceCalculator::Formatter::known(const platform::Geodesy::Bounds& bounds) const {
    for (const Stretch& stretch : stretches) {
        if (bounds.least >= stretch.from && bounds.most <= stretch.to) {
            const auto least = roundedNumber(bounds.least / stretch.metres, stretch.isInTens);
            const auto most = roundedNumber(bounds.most / stretch.metres, stretch.isInTens);
            const auto words = least && least == most ? stretch.words.find(*least) : stretch.words.end();
            return words == stretch.words.end() ? nullptr : &words->second;
        }
    }
    return nullptr;
}

std::optional<std::string> IcuDistanceCalculator::Formatter::known(double metres, UErrorCode& status) {
    const auto found = std::find_if(stretches.begin(), stretches.end(), [metres](const Stretch& stretch) {
        return metres >= stretch.from && metres <= stretch.to;
    });
    if (found == stretches.end()) {
        return std::nullopt;
    }
    const double number = metres / found->metres;
    const auto rounded = roundedNumber(number, found->isInTens);
    if (rounded) {
        if (const auto words = found->words.find(*rounded); words != found->words.end()) {
            return words->second;
        }
    }
    auto words = wordsOf(found->format.formatDouble(number, status), status);
    if (rounded && U_SUCCESS(status)) {
        found->words.emplace(*rounded, words);
    }
    return words;
}

void IcuDistanceCalculator::Formatter::learn(const icu::MeasureUnit& unit, double metres) {
    const std::string_view name = unit.getIdentifier();
    auto found = std::find_if(stretches.begin(), stretches.end(),
                              [name](const Stretch& stretch) { return stretch.unit == name; });
    if (found == stretches.end()) {
        const double size = metresIn(name);
        if (size == 0.0) {
            return;
        }
        const bool isInTens = isShortUnit(unit);
        const auto& format = isInTens ? tens : twoDigits;
        stretches.push_back({std::string(name), size, metres, metres, isInTens, format.unit(unit), {}});
        return;
    }
    found->from = std::min(found->from, metres);
    found->to = std::max(found->to, metres);
}

IcuDistanceCalculator::IcuDistanceCalculator(Settings settings, std::optional<UnitSystem> override,
                                             std::shared_ptr<platform::Geodesy> geodesy)
    : settings_(std::move(settings)),
      system_(UnitSystem::Metric),
      geodesy_(std::move(geodesy)),
      frame_(frameIn(settings_.localizationDelegate)),
      isPlain_(frame_ == kPlainFrame),
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
    const icu::Locale locale = withRegionOverride(language, region);
    const auto plain = icu::number::NumberFormatter::withLocale(locale).unitWidth(UnitWidth::inRow(language));
    formatter_->road = icu::number::NumberFormatter::forSkeleton(u"unit/meter usage/road", status)
                           .unitWidth(UnitWidth::inRow(language))
                           .locale(locale);
    formatter_->tens = plain.precision(icu::number::Precision::increment(kStep));
    formatter_->twoDigits = plain.precision(icu::number::Precision::integer().withMinDigits(2));
    formatter_->usable = U_SUCCESS(status);
}

IcuDistanceCalculator::~IcuDistanceCalculator() = default;

std::optional<std::string> IcuDistanceCalculator::localizedDistance(const platform::PlatformLocation& from,
                                                                    const platform::PlatformLocation& to) {
    // A geodesic is measured to nanometres, of which two or three digits are shown.
    if (const auto bounds = geodesy_->distanceBounds(from.coordinate(), to.coordinate())) {
        if (const std::string* words = formatter_->known(*bounds)) {
            return framed(*words);
        }
    }
    return localizedDistance(geodesy_->distance(from.coordinate(), to.coordinate()));
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
    auto words = formatter_->known(metres, status);
    if (!words) {
        const auto number = formatter_->road.formatDouble(metres, status);
        const icu::MeasureUnit unit = number.getOutputUnit(status);
        if (U_SUCCESS(status) && metres >= kLeastInTens) {
            formatter_->learn(unit, metres);
            words = formatter_->known(metres, status);
        }
        if (!words) {
            words = wordsOf(number, status);
        }
    }
    return U_SUCCESS(status) ? *std::move(words) : std::string();
}

std::string IcuDistanceCalculator::framed(const std::string& text) const {
    return isPlain_ ? text : platform::filled(frame_, {text});
}

long IcuDistanceCalculator::measurementSystem() const {
    return static_cast<long>(system_);
}

}  // namespace ktr::linux_
