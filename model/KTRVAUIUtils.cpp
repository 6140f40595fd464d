#include "model/KTRVAUIUtils.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>
#include <optional>
#include <utility>

#include "model/KTRVALocation.h"
#include "model/PluginBundle.h"
#include "platform/base/Assert.h"
#include "platform/base/Clock.h"
#include "platform/base/Format.h"
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
        date.secondsSinceReferenceDate - platform::Platform::installed()->clock->now().secondsSinceReferenceDate;
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

}  // namespace

KTRVAUIUtils::AgeStrings KTRVAUIUtils::ageStringsForDate(const platform::Date& date) {
    KTR_ASSERT_MAIN_THREAD();
    const Band band = bandOf(ageInSeconds(date));
    std::string row = AssistantLocalizedString(band.rowKey);
    std::string spoken = AssistantLocalizedString(band.spokenKey);
    if (band.number) {
        const std::string number = KTRVALocation::numberFormatter()->plainStringFromInteger(*band.number);
        row = platform::formatted(row, {number});
        spoken = platform::formatted(spoken, {number});
    }
    return {std::move(row), std::move(spoken)};
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
