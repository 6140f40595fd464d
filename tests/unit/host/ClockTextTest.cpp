#include "host/ClockText.h"

#include <gtest/gtest.h>

namespace ktr::host {

namespace {

constexpr double kNoon = 790171200.0;  // 2026-01-15 12:00 UTC

std::string withoutSpaces(std::string text) {
    // Some versions of the locale data put a narrow no-break space before AM and PM.
    for (const std::string& space : {std::string("\u202F"), std::string("\u00A0"), std::string(" ")}) {
        for (auto at = text.find(space); at != std::string::npos; at = text.find(space)) {
            text.erase(at, space.size());
        }
    }
    return text;
}

TEST(KTRClockTextTest, Clock_FollowsTheLanguage) {
    EXPECT_EQ(clockText({kNoon + 5 * 3600 + 42 * 60}, 0, "en-GB", "en-GB"), "17:42");
    EXPECT_EQ(clockText({kNoon + 5 * 3600 + 42 * 60}, 0, "zh-TW", "zh-TW"), "下午5:42");
    EXPECT_EQ(withoutSpaces(clockText({kNoon + 5 * 3600 + 42 * 60}, 0, "el-GR", "el-GR")), "5:42μ.μ.");
    EXPECT_EQ(clockText({kNoon + 5 * 3600 + 42 * 60}, 0, "de", "de-DE"), "17:42");
    EXPECT_EQ(withoutSpaces(clockText({kNoon + 5 * 3600 + 42 * 60}, 0, "en-US", "en-US")), "5:42PM");
}

TEST(KTRClockTextTest, Region_DecidesWhereTheLanguageHasNoCountry) {
    EXPECT_EQ(clockText({kNoon + 5 * 3600}, 0, "en", "en-IE"), "17:00");
    EXPECT_EQ(withoutSpaces(clockText({kNoon + 5 * 3600}, 0, "en", "en-US")), "5:00PM");
    EXPECT_EQ(clockText({kNoon + 5 * 3600}, 0, "de", "en-US"), "17:00");
}

TEST(KTRClockTextTest, Digits_AreThoseOfTheCards) {
    const platform::Date moment{kNoon + 5 * 3600 + 42 * 60};
    EXPECT_EQ(withoutSpaces(clockText(moment, 0, "ar", "ar-EG")), "٥:٤٢م");
    EXPECT_EQ(withoutSpaces(clockText(moment, 0, "ar", "ar-AE")), "5:42م");
    EXPECT_EQ(withoutSpaces(clockText(moment, 0, "ar-EG", "ar-AE")), "5:42م");
    EXPECT_EQ(clockText(moment, 0, "fa-IR", "de-DE"), "۱۷:۴۲");
}

TEST(KTRClockTextTest, Offset_IsTheOneGiven) {
    EXPECT_EQ(clockText({kNoon}, 7200, "en-GB", "en-GB"), "14:00");
    EXPECT_EQ(clockText({kNoon}, -3600, "en-GB", "en-GB"), "11:00");
}

}  // namespace

}  // namespace ktr::host
