#include "server/page/PageLanguage.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "server/page/PageTexts.h"

namespace ktr::test {

using server::PageLanguage;
using server::PageTexts;
using server::shownName;

namespace {

constexpr std::int64_t kNoon = 1763812800;  // 2025-11-22 12:00 UTC
constexpr std::int64_t kHour = 3600;

}  // namespace

TEST(PageLanguageTest, Choose_TakesTheChosenOne_ElseTheHeaviestThatThereIs) {
    EXPECT_EQ(PageLanguage::choose("", "xx;q=1, en;q=0.5"), "en");
    EXPECT_EQ(PageLanguage::choose("", ""), "en");
    EXPECT_EQ(PageLanguage::choose("", "fr;q=0.3, de-AT;q=0.9, en;q=0.5"), "de");
    EXPECT_EQ(PageLanguage::choose("", "en;q=0, de;q=0.001"), "de");
    EXPECT_EQ(PageLanguage::choose("ar", "de"), "ar");
    EXPECT_EQ(PageLanguage::choose("xx", "de"), "de");
    EXPECT_EQ(PageLanguage::choose("", "zh-TW"), "zh-Hant");
    EXPECT_EQ(PageLanguage::choose("", "zh-CN"), "zh-Hans");
    EXPECT_EQ(PageLanguage::choose("", "pt-PT"), "pt");
    EXPECT_EQ(PageLanguage::choose("", "iw"), "he");
    EXPECT_EQ(PageLanguage::choose("nonsense!", "*"), "en");
    EXPECT_EQ(PageLanguage::choose("", ";;;,,,q=,=;q=9"), "en");
    EXPECT_EQ(PageLanguage::choose("", std::string(100000, ',')), "en");
}

TEST(PageLanguageTest, MomentsAreInTheReadersZone) {
    const PageLanguage utc("en", "UTC");
    const PageLanguage auckland("en", "Pacific/Auckland");  // 13 hours ahead
    EXPECT_NE(utc.clock(kNoon).find("12:00"), std::string::npos) << utc.clock(kNoon);
    EXPECT_NE(auckland.clock(kNoon).find("1:00"), std::string::npos) << auckland.clock(kNoon);
    EXPECT_EQ(utc.fieldTime(kNoon), "12:00");
    EXPECT_EQ(auckland.fieldTime(kNoon), "01:00");
    EXPECT_EQ(utc.day(kNoon, kNoon), "Today");
    EXPECT_EQ(utc.day(kNoon - 24 * kHour, kNoon), "Yesterday");
    EXPECT_EQ(auckland.day(kNoon - 2 * kHour, kNoon), "Yesterday");
    EXPECT_EQ(utc.day(kNoon - 2 * kHour, kNoon), "Today");
    EXPECT_EQ(utc.day(kNoon - 5 * 24 * kHour, kNoon), "Nov 17");
    EXPECT_TRUE(utc.moment(kNoon, kNoon).starts_with("Today, 12:00")) << utc.moment(kNoon, kNoon);
}

TEST(PageLanguageTest, UnknownZoneIsUtc) {
    EXPECT_EQ(PageLanguage("en", "Mars/Olympus").zone(), "UTC");
    EXPECT_EQ(PageLanguage("en", "Europe/Berlin").zone(), "Europe/Berlin");
    EXPECT_TRUE(PageLanguage::isZone("UTC"));
    EXPECT_FALSE(PageLanguage::isZone(""));
}

TEST(PageLanguageTest, AgesAndDistances) {
    const PageLanguage english("en", "UTC");
    EXPECT_EQ(english.age(0), "Now");
    EXPECT_EQ(english.age(240), "4 min. ago");
    EXPECT_EQ(english.age(7300), "2 hr. ago");
    EXPECT_EQ(english.metres(19.2), "20 m");
    EXPECT_EQ(english.metres(2828.4), "2.8 km");
    EXPECT_EQ(english.hours(48), "48 hours");
    EXPECT_EQ(english.days(1), "1 day");
}

TEST(PageLanguageTest, ArgumentsAreSetApartFromTheTextAroundThem) {
    EXPECT_EQ(PageLanguage("en", "UTC").text("STOP", {"נועם"}), "Stop sharing with \u2068נועם\u2069");
}

TEST(PageLanguageTest, EveryLanguageHasEveryText_AndCallsItselfByAName) {
    EXPECT_EQ(PageTexts::languages().size(), 21U);
    for (const std::string_view tag : PageTexts::languages()) {
        const PageLanguage language{std::string(tag), "UTC"};
        EXPECT_FALSE(PageLanguage::ownName(std::string(tag)).empty());
        EXPECT_EQ(language.isRightToLeft(), tag == "ar" || tag == "he" || tag == "fa") << tag;
        EXPECT_NE(language.plural("VISIBLE_TO", 3), "VISIBLE_TO");
        const std::string numbers(PageTexts::find(tag, "NUMBERS"));
        EXPECT_TRUE(numbers == "-" || std::count(numbers.begin(), numbers.end(), '|') == 11) << tag;
    }
}

TEST(PageLanguageTest, UnknownKeyIsItself) {
    EXPECT_EQ(PageTexts::find("en", "NO_SUCH_KEY"), "NO_SUCH_KEY");
}

TEST(ShownNameTest, LosesWhatTurnsTheTextAroundIt) {
    EXPECT_EQ(shownName("Ann\u202E\u2066 Marsh\u200F"), "Ann Marsh");
    EXPECT_EQ(shownName("a\nb"), "a b");
}

TEST(ShownNameTest, TenThousandLettersAreCut) {
    EXPECT_EQ(shownName(std::string(10000, 'a')), std::string(60, 'a') + "…");
    EXPECT_EQ(shownName(std::string(60, 'a')), std::string(60, 'a'));
}

}  // namespace ktr::test
