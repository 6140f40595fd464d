#include "linux/locale/IcuDistanceCalculator.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <random>
#include <utility>

#include <unicode/locid.h>
#include <unicode/numberformatter.h>

#include "linux/locale/IcuNumberFormatter.h"
#include "linux/locale/LocaleRegion.h"
#include "linux/locale/UnitWidth.h"
#include "linux/positions/GeographicLibGeodesy.h"
#include "tests/support/Doubles.h"

namespace ktr::linux_ {

namespace {

class IcuDistanceCalculatorTest : public ::testing::Test {
  protected:
    IcuDistanceCalculator calculator(std::optional<std::string> language, const std::string& region,
                                     std::optional<UnitSystem> override = std::nullopt) {
        return {{"group", std::move(language), region, nullptr}, override, std::make_shared<GeographicLibGeodesy>()};
    }
    std::string text(std::optional<std::string> language, const std::string& region, double metres) {
        return calculator(std::move(language), region).localizedDistance(metres).value_or("(none)");
    }
};

}  // namespace

TEST_F(IcuDistanceCalculatorTest, ShortDistances_AreToldInTens) {
    EXPECT_EQ(text("en-GB", "de-DE", 310.0), "310\u00a0m");
    EXPECT_EQ(text("en-GB", "de-DE", 624.9), "620\u00a0m");
    EXPECT_EQ(text("en-US", "en-US", 140.0), "460\u00a0ft");
    EXPECT_EQ(text("en-GB", "de-DE", 1234.0), "1.2\u00a0km");
}

TEST_F(IcuDistanceCalculatorTest, UnitsFollowTheRegionAndWordsTheLanguage) {
    EXPECT_EQ(text("en-GB", "de-DE", 3.0), "3\u00a0m");
    EXPECT_EQ(text("de", "de-DE", 950.0), "0,95\u00a0km");
    EXPECT_EQ(text("de", "en-US", 950.0), "0,59\u00a0mi");
    EXPECT_EQ(text("en-US", "en-US", 3.0), "10\u00a0ft");
    EXPECT_EQ(text("en-US", "en-GB", 3.0), "3\u00a0yd");
    EXPECT_EQ(text("ja", "ja-JP", 2400.0), "2.4\u00a0km");
    EXPECT_EQ(text("en", "fr-FR", 540123.0), "540\u00a0km");
}

TEST_F(IcuDistanceCalculatorTest, Arabic_AbbreviatesTheUnitAndHasItsOwnDigits) {
    EXPECT_EQ(text("ar", "ar-EG", 120.0), "١٢٠\u00a0م");
    EXPECT_EQ(text("ar", "ar-EG", 2400.0), "٢٫٤\u00a0كم");
}

TEST_F(IcuDistanceCalculatorTest, Persian_HasNoLatinLetters) {
    EXPECT_EQ(text("fa", "fa-IR", 120.0), "۱۲۰\u00a0متر");
    EXPECT_EQ(text("fa", "fa-IR", 2400.0), "۲٫۴\u00a0کیلومتر");
}

TEST_F(IcuDistanceCalculatorTest, Digits_AreThoseOfTheNumbersBesideIt) {
    for (const char* region : {"ar-AE", "ar-EG", "ar-MA", "fa-IR", "de-DE"}) {
        for (const char* language : {"ar", "fa", "en-GB"}) {
            const auto five =
                IcuNumberFormatter(LocaleRegion(region).localeWithLanguage(language)).plainStringFromInteger(5);
            EXPECT_EQ(text(language, region, 5.0).substr(0, five.size()), five) << language << " in " << region;
        }
    }
    EXPECT_EQ(text("ar", "ar-AE", 120.0), "120\u00a0م");
}

TEST_F(IcuDistanceCalculatorTest, WithoutALanguage_TheRegionsOwnIsUsed) {
    EXPECT_EQ(text(std::nullopt, "de-AT", 950.0), "0,95\u00a0km");
}

// Once a unit is known to serve a distance it is not asked for again: the words must stay those that ICU chooses.
TEST_F(IcuDistanceCalculatorTest, ManyDistances_AreWordedAsIcuWordsRoads) {
    std::mt19937 random(5);
    std::uniform_real_distribution<double> exponent(0.0, 7.2);
    for (const char* tag :
         {"ar-EG", "de-DE", "el-GR", "en-GB", "en-US", "es-ES", "fa-IR", "fr-FR", "he-IL", "hi-IN", "it-IT",
          "ja-JP", "ko-KR", "nl-NL", "pl-PL", "pt-BR", "ru-RU", "sv-SE", "tr-TR", "uk-UA", "zh-CN", "zh-TW"}) {
        UErrorCode status = U_ZERO_ERROR;
        const auto locale = icu::Locale::forLanguageTag(tag, status);
        const auto road = icu::number::NumberFormatter::forSkeleton(u"unit/meter usage/road", status)
                              .unitWidth(UnitWidth::inRow(locale));
        const auto whole = road.locale(locale);
        const auto tens = road.precision(icu::number::Precision::increment(10.0)).locale(locale);
        const auto wording = calculator(std::nullopt, tag);
        for (int i = 0; i < 400; ++i) {
            const double metres =
                i % 4 == 0 ? std::round(std::pow(10.0, exponent(random))) : std::pow(10.0, exponent(random));
            auto expected = whole.formatDouble(metres, status);
            const std::string unit = expected.getOutputUnit(status).getIdentifier();
            if (metres >= 10.0 && (unit == "meter" || unit == "yard" || unit == "foot")) {
                expected = tens.formatDouble(metres, status);
            }
            std::string text;
            expected.toString(status).findAndReplace(u" ", u"\u00a0").toUTF8String(text);
            ASSERT_EQ(wording.localizedDistance(metres).value_or("(none)"), text) << tag << ", " << metres << " m";
        }
        ASSERT_TRUE(U_SUCCESS(status));
    }
}

namespace {

struct CountingGeodesy : GeographicLibGeodesy {
    double distance(const platform::Coordinate& from, const platform::Coordinate& to) const override {
        ++asked;
        return GeographicLibGeodesy::distance(from, to);
    }
    mutable int asked = 0;
};

/// Tells nothing without measuring.
struct MeasuringGeodesy : GeographicLibGeodesy {
    std::optional<Bounds> distanceBounds(const platform::Coordinate&, const platform::Coordinate&) const override {
        return std::nullopt;
    }
};

platform::PlatformLocation at(double latitude, double longitude) {
    platform::PlatformLocation::Fix fix;
    fix.coordinate = {latitude, longitude};
    return platform::PlatformLocation(fix);
}

}  // namespace

TEST_F(IcuDistanceCalculatorTest, WordsThatAreKnown_AreFoundWithoutMeasuring) {
    const auto geodesy = std::make_shared<CountingGeodesy>();
    IcuDistanceCalculator calculator({"group", "en-GB", "de-DE", nullptr}, std::nullopt, geodesy);
    const auto user = at(50.0, 8.0);
    const auto wordAll = [&](double walked) {
        for (int i = 0; i < 1000; ++i) {
            calculator.localizedDistance(user, at(50.01 + 0.0007 * i + walked, 8.0 - walked));
        }
        return std::exchange(geodesy->asked, 0);
    };
    wordAll(0.0);
    // Everybody walks on, to distances that were not worded yet as well: a few are measured, where a digit turns.
    EXPECT_LT(wordAll(0.0003), 100);
    EXPECT_LT(wordAll(0.0003), 20) << "and the same once more";
    EXPECT_EQ(calculator.localizedDistance(user, at(NAN, 8.0)), std::nullopt);
}

TEST_F(IcuDistanceCalculatorTest, Words_AreThoseOfTheMeasuredDistance) {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> unit(-1.0, 1.0);
    for (const char* tag : {"de-DE", "en-GB", "en-US", "sv-SE", "ar-EG", "ja-JP"}) {
        const platform::DistanceCalculator::Settings settings{"group", std::nullopt, tag, nullptr};
        IcuDistanceCalculator quick(settings, std::nullopt, std::make_shared<GeographicLibGeodesy>());
        IcuDistanceCalculator exact(settings, std::nullopt, std::make_shared<MeasuringGeodesy>());
        for (const double degrees : {1e-4, 1e-3, 0.02, 0.5, 10.0, 90.0}) {
            for (int i = 0; i < 1000; ++i) {
                const auto from = at(80.0 * unit(random), 180.0 * unit(random));
                const auto to = at(std::clamp(from.coordinate().latitude + degrees * unit(random), -90.0, 90.0),
                                   std::remainder(from.coordinate().longitude + degrees * unit(random), 360.0));
                ASSERT_EQ(quick.localizedDistance(from, to), exact.localizedDistance(from, to))
                    << tag << ", " << GeographicLibGeodesy().distance(from.coordinate(), to.coordinate()) << " m";
            }
        }
    }
}

TEST_F(IcuDistanceCalculatorTest, EveryBlankIsOneThatDoesNotBreak) {
    for (const char* region : {"en-US", "en-GB", "de-DE", "fr-FR", "ar-EG", "ja-JP", "hi-IN"}) {
        for (const double metres : {1.0, 75.0, 640.0, 1500.0, 1e6}) {
            EXPECT_EQ(text(std::nullopt, region, metres).find(' '), std::string::npos) << region << " " << metres;
        }
    }
}

TEST_F(IcuDistanceCalculatorTest, MeasurementSystem_FollowsTheRegion) {
    EXPECT_EQ(calculator("en", "de-DE").measurementSystem(), 0);
    EXPECT_EQ(calculator("de", "en-US").measurementSystem(), 1);
    EXPECT_EQ(calculator("de", "en-GB").measurementSystem(), 2);
    EXPECT_EQ(calculator("de", "en").measurementSystem(), 1);
    EXPECT_EQ(calculator("de", "").measurementSystem(), calculator("de", "und").measurementSystem());
}

TEST_F(IcuDistanceCalculatorTest, LocaleKeywords_ChooseTheUnits) {
    EXPECT_EQ(text("en", "en-US-u-ms-metric", 3.0), "3\u00a0m");
    EXPECT_EQ(calculator("en", "en-US-u-ms-metric").measurementSystem(), 0);
    EXPECT_EQ(text("en", "de-DE-u-ms-uksystem", 3.0), "3\u00a0yd");
    EXPECT_EQ(calculator("en", "de-DE-u-ms-uksystem").measurementSystem(), 2);
    EXPECT_EQ(text("en", "de-DE-u-rg-uszzzz", 3.0), "10\u00a0ft");
}

TEST_F(IcuDistanceCalculatorTest, AnOverride_BeatsTheRegion) {
    const auto metric = calculator("en-US", "en-US", UnitSystem::Metric);
    EXPECT_EQ(metric.localizedDistance(3.0), "3\u00a0m");
    EXPECT_EQ(metric.measurementSystem(), 0);
    const auto british = calculator("de", "de-DE", UnitSystem::ImperialUK);
    EXPECT_EQ(british.localizedDistance(3.0), "3\u00a0yd");
    EXPECT_EQ(british.measurementSystem(), 2);
}

TEST_F(IcuDistanceCalculatorTest, TheHostsText_FramesTheDistance) {
    auto texts = std::make_shared<test::FakeLocalization>();
    texts->set(texts->hostBundle, "DISTANCE_TEXT", "about %@");
    const IcuDistanceCalculator framed({"group", "en", "de-DE", texts}, std::nullopt,
                                       std::make_shared<GeographicLibGeodesy>());
    EXPECT_EQ(framed.localizedDistance(3.0), "about 3\u00a0m");
    texts->texts.clear();
    const IcuDistanceCalculator plain({"group", "en", "de-DE", texts}, std::nullopt,
                                      std::make_shared<GeographicLibGeodesy>());
    EXPECT_EQ(plain.localizedDistance(3.0), "3\u00a0m");
}

TEST_F(IcuDistanceCalculatorTest, NoDistance_GivesNone) {
    const auto metric = calculator("en", "de-DE");
    EXPECT_EQ(metric.localizedDistance(std::nan("")), std::nullopt);
    EXPECT_EQ(metric.localizedDistance(std::numeric_limits<double>::infinity()), std::nullopt);
    EXPECT_EQ(metric.localizedDistance(-1.0), std::nullopt);
    EXPECT_EQ(metric.localizedDistance(0.0), "0\u00a0m");
}

TEST_F(IcuDistanceCalculatorTest, Positions_AreMeasuredOnTheEllipsoid) {
    auto metric = calculator("en", "de-DE");
    const platform::PlatformLocation from({{50.0, 7.0}, 0, 10, -1, -1, -1, std::nullopt});
    const platform::PlatformLocation to({{50.0, 7.1}, 0, 10, -1, -1, -1, std::nullopt});
    EXPECT_EQ(metric.localizedDistance(from, to), "7.2\u00a0km");
}

}  // namespace ktr::linux_
