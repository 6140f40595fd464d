#include "service/KTRVAUtils.h"

#include <cmath>
#include <limits>

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Date;
using platform::Dictionary;
using platform::Url;
using platform::Value;

const std::string kPrefix = "ktrServerContext://serverContext?";

class KTRVAUtilsTest : public PlatformTest {
  protected:
    static Dictionary decoded(const std::string& rest) {
        return KTRVAUtils::contextDictionaryForURL(Url(kPrefix + rest));
    }
    static std::string encoded(const Dictionary& dictionary) {
        const auto url = KTRVAUtils::contextIdentifierURLForDictionary(dictionary);
        return url ? url->text() : "none";
    }
    static std::shared_ptr<platform::VALocation> place(std::optional<double> latitude, std::optional<double> longitude,
                                                       std::optional<double> accuracy = std::nullopt) {
        auto location = std::make_shared<platform::VALocation>();
        location->latitude = latitude;
        location->longitude = longitude;
        location->accuracy = accuracy;
        return location;
    }
};

TEST_F(KTRVAUtilsTest, MillisecondsConvertToSecondsSinceTheReferenceDateAndBack) {
    EXPECT_EQ(KTRVAUtils::timeIntervalForMillisecondsSince1970(1000.0), -978307199.0);
    EXPECT_EQ(KTRVAUtils::millisecondsSince1970ForTimeInterval(-978307199.0), 1000.0);
    EXPECT_EQ(KTRVAUtils::timeIntervalForMillisecondsSince1970(0.0), -978307200.0);
}

TEST_F(KTRVAUtilsTest, TimesKeepTheirFractions) {
    EXPECT_DOUBLE_EQ(*KTRVAUtils::timeIntervalForMillisecondsSince1970(978307200250.0), 0.25);
    EXPECT_DOUBLE_EQ(*KTRVAUtils::millisecondsSince1970ForTimeInterval(0.0005), 978307200000.5);
}

TEST_F(KTRVAUtilsTest, NoTimeGivesNone) {
    EXPECT_EQ(KTRVAUtils::timeIntervalForMillisecondsSince1970(std::nullopt), std::nullopt);
    EXPECT_EQ(KTRVAUtils::millisecondsSince1970ForTimeInterval(std::nullopt), std::nullopt);
}

TEST_F(KTRVAUtilsTest, TodayAtMidnight_KeepsTheFractionOfTheSecond_IsKept) {
    time->advance(3661.75);  // 13:01:01.75
    const double midnight = kNoon - 43200.0;
    EXPECT_DOUBLE_EQ(KTRVAUtils::todayAtMidnight().secondsSinceReferenceDate, midnight + 0.75);
}

TEST_F(KTRVAUtilsTest, YesterdayAtMidnightIsAFixedDayEarlier) {
    EXPECT_DOUBLE_EQ(KTRVAUtils::yesterdayAtMidnight().secondsSinceReferenceDate, kNoon - 43200.0 - 86400.0);
}

/// Noon of a day whose clocks went forward by an hour at 01:00: midnight lies eleven hours back.
struct SpringCalendar : UtcCalendar {
    Date adding(TimeOfDay amounts, Date date) const override {
        return {UtcCalendar::adding(amounts, date).secondsSinceReferenceDate + 3600.0};
    }
};

TEST_F(KTRVAUtilsTest, TodayAtMidnight_CountsOnTheClockFaceThroughTheCalendar) {
    platform->calendar = std::make_shared<SpringCalendar>();
    EXPECT_DOUBLE_EQ(KTRVAUtils::todayAtMidnight().secondsSinceReferenceDate, kNoon - 11.0 * 3600.0);
    EXPECT_DOUBLE_EQ(KTRVAUtils::yesterdayAtMidnight().secondsSinceReferenceDate, kNoon - 11.0 * 3600.0 - 86400.0);
}

TEST_F(KTRVAUtilsTest, EncodingNoneGivesNone) {
    EXPECT_EQ(KTRVAUtils::contextIdentifierURLForDictionary(std::nullopt), std::nullopt);
}

TEST_F(KTRVAUtilsTest, EncodingWritesEveryMemberInOrderAndEndsInAnAmpersand) {
    EXPECT_EQ(encoded({{"minCallbackIntervalInMS", 60000}, {"incomplete", true}}),
              kPrefix + "minCallbackIntervalInMS=60000&incomplete=1&");
    EXPECT_EQ(encoded({}), kPrefix);
}

TEST_F(KTRVAUtilsTest, EncodingNeverWritesTheToken) {
    EXPECT_EQ(encoded({{"authToken", "secret"}, {"a", "b"}}), kPrefix + "a=b&");
    const Dictionary nested{{"authToken", "secret"}, {"c", 1}};
    EXPECT_EQ(encoded({{"a", nested}, {"b", platform::Value::Array{nested}}}),
              kPrefix + "a=%7B%22c%22%3A1%7D&b=%5B%7B%22c%22%3A1%7D%5D&");
    EXPECT_TRUE(decoded("a=b&").find("authToken") == nullptr);
}

TEST_F(KTRVAUtilsTest, EncodingWritesTextualDescriptions) {
    EXPECT_EQ(encoded({{"a", false}, {"b", -1}, {"c", 2.0}, {"d", 0.05}, {"e", nullptr}}),
              kPrefix + "a=0&b=-1&c=2&d=0.05&e=%3Cnull%3E&");
    EXPECT_EQ(encoded({{"a", Value::Array{1}}}), kPrefix + "a=%5B1%5D&");
}

TEST_F(KTRVAUtilsTest, EncodingEscapesAllButUnreservedCharacters) {
    EXPECT_EQ(encoded({{"a&b", "AZaz09-._~"}, {"k=", "%&=+ /?é"}}),
              kPrefix + "a%26b=AZaz09-._~&k%3D=%25%26%3D%2B%20%2F%3F%C3%A9&");
}

TEST_F(KTRVAUtilsTest, DecodingReadsNumbersAndStringsAndSkipsWhatIsNoPair) {
    const Dictionary dictionary = decoded("x=12&y=abc&z&");
    EXPECT_EQ(dictionary, (Dictionary{{"x", 12}, {"y", "abc"}}));
}

TEST_F(KTRVAUtilsTest, DecodingDropsThePrefixLengthWhateverStandsThere) {
    EXPECT_EQ(KTRVAUtils::contextDictionaryForURL(Url(std::string(kPrefix.size(), 'x') + "a=1")),
              (Dictionary{{"a", 1}}));
    EXPECT_EQ(KTRVAUtils::contextDictionaryForURL(Url("short?a=1")), Dictionary());
    std::string wide;
    for (std::size_t i = 0; i < kPrefix.size(); ++i) {
        wide += "é";
    }
    EXPECT_EQ(KTRVAUtils::contextDictionaryForURL(Url(wide + "a=1")), (Dictionary{{"a", 1}}))
        << "characters, not bytes";
}

TEST_F(KTRVAUtilsTest, DecodingUnescapesKeysAndValues) {
    EXPECT_EQ(decoded("a%26b=%25%3d%C3%A9&"), (Dictionary{{"a&b", "%=é"}}));
    EXPECT_EQ(decoded("a=%31%32"), (Dictionary{{"a", 12}})) << "numeric once it is unescaped";
}

TEST_F(KTRVAUtilsTest, DecodingSkipsInvalidSequencesAndBytes) {
    EXPECT_EQ(decoded("a=%&b=%4&c=%zz&d=%FF&e=\xFF&%C3=1&ok=%41"), (Dictionary{{"ok", "A"}}));
}

TEST_F(KTRVAUtilsTest, DecodingAnEmptyValueIsAPair) {
    EXPECT_EQ(decoded("a=&=b&c==d&e=f=g"), (Dictionary{{"a", ""}, {"", "b"}}));
}

TEST_F(KTRVAUtilsTest, DecodingAPlusIsNoBlank) {
    EXPECT_EQ(decoded("a=b+c"), (Dictionary{{"a", "b+c"}}));
}

TEST_F(KTRVAUtilsTest, DecodingNumericIsAnOptionalSignAndDigitsOnly) {
    EXPECT_EQ(decoded("a=+7&b=-7&c=007&d=0.2&e=1e3&f=-&g=1-&h=%201&i=%D9%A1"), (Dictionary{{"a", 7},
                                                                                           {"b", -7},
                                                                                           {"c", 7},
                                                                                           {"d", "0.2"},
                                                                                           {"e", "1e3"},
                                                                                           {"f", "-"},
                                                                                           {"g", "1-"},
                                                                                           {"h", " 1"},
                                                                                           {"i", "١"}}));
}

TEST_F(KTRVAUtilsTest, DecodingSaturatesNumbersTo32Bits) {
    EXPECT_EQ(decoded("a=2147483648&b=2147483647&c=-2147483649&d=-2147483648&e=99999999999999999999999999"),
              (Dictionary{{"a", 2147483647},
                          {"b", 2147483647},
                          {"c", Value(std::int64_t{-2147483648})},
                          {"d", Value(std::int64_t{-2147483648})},
                          {"e", 2147483647}}));
}

TEST_F(KTRVAUtilsTest, DecodingALaterDuplicateOverwrites) {
    EXPECT_EQ(decoded("a=1&b=2&a=x"), (Dictionary{{"a", "x"}, {"b", 2}}));
}

TEST_F(KTRVAUtilsTest, StringsSurviveEncodingAndDecoding) {
    const Dictionary strings{{"name", "Ann & Bob = 100 % +"}, {"日本", "🙂"}, {"empty", ""}};
    EXPECT_EQ(KTRVAUtils::contextDictionaryForURL(*KTRVAUtils::contextIdentifierURLForDictionary(strings)), strings);
}

TEST_F(KTRVAUtilsTest, GeoLocation_EquatorAndPrimeMeridianCountAsUnknown_IsKept) {
    EXPECT_EQ(KTRVAUtils::geoLocationForVALocation(place(0.0, 10.0)), nullptr);
    EXPECT_EQ(KTRVAUtils::geoLocationForVALocation(place(51.48, 0.0)), nullptr);
    EXPECT_EQ(KTRVAUtils::geoLocationForVALocation(place(-0.0, 10.0)), nullptr);
}

TEST_F(KTRVAUtilsTest, GeoLocation_MissingNumbersReadAsZero) {
    EXPECT_EQ(KTRVAUtils::geoLocationForVALocation(nullptr), nullptr);
    EXPECT_EQ(KTRVAUtils::geoLocationForVALocation(place(std::nullopt, 10.0)), nullptr);
    EXPECT_EQ(KTRVAUtils::geoLocationForVALocation(place(10.0, std::nullopt)), nullptr);
    EXPECT_EQ(KTRVAUtils::geoLocationForVALocation(place(10.0, 20.0))->fix().horizontalAccuracy, 0.0);
}

TEST_F(KTRVAUtilsTest, GeoLocation_IsFixedNow) {
    const auto friendPlace = std::make_shared<platform::VAKtrLocation>();
    friendPlace->latitude = 48.1;
    friendPlace->longitude = 11.6;
    friendPlace->accuracy = 65.0;
    friendPlace->locationDate = 5.0;
    time->advance(90.0);
    const auto location = KTRVAUtils::geoLocationForVALocation(friendPlace);
    ASSERT_TRUE(location);
    platform::PlatformLocation::Fix expected;
    expected.coordinate = {48.1, 11.6};
    expected.horizontalAccuracy = 65.0;
    expected.timestamp = Date{kNoon + 90.0};
    EXPECT_EQ(location->fix(), expected);
}

TEST_F(KTRVAUtilsTest, DictionaryForLocation_NoneReadsAsZero_IsKept) {
    const auto dictionary = KTRVAUtils::dictionaryForLocation(nullptr);
    ASSERT_TRUE(dictionary);
    EXPECT_EQ(*dictionary, (Dictionary{{"latitude", 0.0}, {"longitude", 0.0}, {"source", "assistant"}}));
}

TEST_F(KTRVAUtilsTest, DictionaryForLocation_HoldsAccuracyAndTime) {
    const auto dictionary = KTRVAUtils::dictionaryForLocation(position(48.1, 11.6, 12.5));
    ASSERT_TRUE(dictionary);
    EXPECT_EQ(*dictionary, (Dictionary{{"latitude", 48.1},
                                       {"longitude", 11.6},
                                       {"source", "assistant"},
                                       {"horizontalAccuracy", 12.5},
                                       {"timestamp", (kNoon + 978307200.0) * 1000.0}}));
}

TEST_F(KTRVAUtilsTest, DictionaryForLocation_LeavesOutNoAccuracyAndTheReferenceDate) {
    platform::PlatformLocation::Fix fix;
    fix.coordinate = {48.1, 11.6};
    fix.timestamp = Date{0.0};
    const auto dictionary = KTRVAUtils::dictionaryForLocation(std::make_shared<platform::PlatformLocation>(fix));
    EXPECT_EQ(*dictionary, (Dictionary{{"latitude", 48.1}, {"longitude", 11.6}, {"source", "assistant"}}));
}

TEST_F(KTRVAUtilsTest, DictionaryForLocation_NegativeAccuracyIsSentAsItIs_IsKept) {
    EXPECT_EQ(KTRVAUtils::dictionaryForLocation(position(1.0, 2.0, -1.0))->find("horizontalAccuracy")->number(), -1.0);
}

TEST_F(KTRVAUtilsTest, DictionaryForLocation_InvalidCoordinatesGiveNone) {
    const double nan = std::nan("");
    for (const auto& [latitude, longitude] :
         {std::pair{90.5, 0.0}, {-91.0, 0.0}, {0.0, 180.5}, {0.0, -181.0}, {nan, 0.0}, {0.0, nan}}) {
        EXPECT_EQ(KTRVAUtils::dictionaryForLocation(position(latitude, longitude)), std::nullopt);
    }
    EXPECT_TRUE(KTRVAUtils::dictionaryForLocation(position(-90.0, 180.0)));
}

TEST_F(KTRVAUtilsTest, TheAppIsAlwaysTakenToBeInstalled_IsKept) {
    EXPECT_TRUE(KTRVAUtils::isKTRAppInstalled());
}

}  // namespace
}  // namespace ktr::test
