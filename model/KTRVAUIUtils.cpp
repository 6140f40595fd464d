#include "model/KTRVAUIUtils.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>
#include <optional>
#include <unordered_map>
#include <utility>

#include "model/KTRVALocation.h"
#include "model/PluginBundle.h"
#include "platform/base/Assert.h"
#include "platform/base/Clock.h"
#include "platform/base/CurrentPlatform.h"
#include "platform/base/FilledText.h"
#include "platform/base/Platform.h"

namespace ktr {

namespace {

/// An age as it is said: the texts' keys, and the number put into both.
struct Band {
    int rank;  ///< from 0, the newest
    const char* rowKey;
    const char* spokenKey;
    std::optional<std::int64_t> number;
};

/// The whole seconds between now and the date, either way, at most 2^31.
std::int64_t ageInSeconds(const platform::Date& date) {
    const double interval =
        date.secondsSinceReferenceDate - platform::currentPlatform()->clock->now().secondsSinceReferenceDate;
    if (std::isnan(interval)) {
        return 0;
    }
    const double clamped = std::clamp(interval, static_cast<double>(std::numeric_limits<std::int32_t>::min()),
                                      static_cast<double>(std::numeric_limits<std::int32_t>::max()));
    return std::abs(static_cast<std::int64_t>(clamped));
}

// The keys do not describe their bands literally: the texts are written to match the bands.
Band bandOf(std::int64_t seconds) {
    const double minutes = static_cast<double>(seconds) / 60.0;
    if (minutes <= 0.5) {
        return {0, "LOCATED_NOW", "ACCESSIBILITY_LOCATED_NOW", std::nullopt};
    }
    if (minutes < 1.0) {
        return {1, "LOCATED_LESS_THAN_30SECONDS", "ACCESSIBILITY_LOCATED_LESS_THAN_30SECONDS", 30};
    }
    if (minutes < 60.0) {
        const auto whole = static_cast<std::int64_t>(minutes);
        return {2, "LOCATED_MINUTES", whole == 1 ? "ACCESSIBILITY_LOCATED_MINUTE" : "ACCESSIBILITY_LOCATED_MINUTES",
                whole};
    }
    if (minutes < 120.0) {
        return {3, "LOCATED_LESS_THAN_1HR", "ACCESSIBILITY_LOCATED_LESS_THAN_1HR", 1};
    }
    return {4, "LOCATED_MORE_THAN_1HR", "ACCESSIBILITY_LOCATED_MORE_THAN_1HR",
            static_cast<std::int64_t>(minutes / 60.0)};
}

/// There are few ages, and rows are filled again and again: each is worded once.
struct WordedAges {
    static std::shared_ptr<WordedAges> makeShared() { return std::make_shared<WordedAges>(); }
    /// Minutes, and hours of more than a week.
    static constexpr std::size_t kMost = 256;
    std::unordered_map<std::int64_t, KTRVAUIUtils::AgeStrings> byNumber;
    /// What they are worded by: with others they are worded anew.
    std::shared_ptr<platform::Localization> texts;
    std::shared_ptr<platform::NumberFormatter> numbers;
};

KTRVAUIUtils::AgeStrings worded(const Band& band) {
    std::string row = AssistantLocalizedString(band.rowKey);
    std::string spoken = AssistantLocalizedString(band.spokenKey);
    if (band.number) {
        const std::string number = KTRVALocation::numberFormatter()->plainStringFromInteger(*band.number);
        row = platform::filled(row, {number});
        spoken = platform::filled(spoken, {number});
    }
    return {std::move(row), std::move(spoken)};
}

WordedAges& wordedAges() {
    WordedAges& ages = *platform::shared<WordedAges>();
    const auto& texts = platform::currentPlatform()->localization;
    const auto numbers = KTRVALocation::numberFormatter();
    if (ages.texts != texts || ages.numbers != numbers) {
        ages.byNumber.clear();
        ages.texts = texts;
        ages.numbers = numbers;
    }
    return ages;
}

}  // namespace

KTRVAUIUtils::AgeStrings KTRVAUIUtils::ageStringsForDate(const platform::Date& date) {
    KTR_ASSERT_MAIN_THREAD();
    constexpr std::int64_t kRanks = 5;
    const Band band = bandOf(ageInSeconds(date));
    auto& known = wordedAges().byNumber;
    const std::int64_t place = band.number.value_or(0) * kRanks + band.rank;
    if (const auto found = known.find(place); found != known.end()) {
        return found->second;
    }
    if (known.size() == WordedAges::kMost) {
        known.clear();
    }
    return known.emplace(place, worded(band)).first->second;
}

platform::Dictionary KTRVAUIUtils::dictionaryWithAgeStringsForDate(const platform::Date& date) {
    auto strings = ageStringsForDate(date);
    return {{LabelStringKey, std::move(strings.shown)}, {LabelAccessibilityStringKey, std::move(strings.spoken)}};
}

int KTRVAUIUtils::ageBandForDate(const platform::Date& date) {
    KTR_ASSERT_MAIN_THREAD();
    return bandOf(ageInSeconds(date)).rank;
}

}  // namespace ktr
