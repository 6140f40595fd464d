#include "linux/locale/IcuNumberFormatter.h"

#include <gtest/gtest.h>

#include <clocale>

namespace ktr::linux_ {

TEST(IcuNumberFormatterTest, Decimals_AreReadInTheLocalesStyle) {
    EXPECT_EQ(IcuNumberFormatter("de-DE").numberFromString("1234,5"), 1234.5);
    EXPECT_EQ(IcuNumberFormatter("de-DE").numberFromString("1.234,5"), 1234.5);
    EXPECT_EQ(IcuNumberFormatter("en-GB").numberFromString("1,234.5"), 1234.5);
    EXPECT_EQ(IcuNumberFormatter("ar-EG").numberFromString("٣١٠٫٥"), 310.5);
}

TEST(IcuNumberFormatterTest, AsciiDigits_AreReadInEveryLocale) {
    EXPECT_EQ(IcuNumberFormatter("ar-EG").numberFromString("310"), 310.0);
    EXPECT_EQ(IcuNumberFormatter("fa-IR").numberFromString("310"), 310.0);
}

TEST(IcuNumberFormatterTest, AGroupingSeparatorOutOfPlace_MakesItNoNumber) {
    EXPECT_EQ(IcuNumberFormatter("de-DE").numberFromString("1234.5"), std::nullopt);
    EXPECT_EQ(IcuNumberFormatter("de-DE").numberFromString("310.25"), std::nullopt);
}

TEST(IcuNumberFormatterTest, InfinityAndNotANumber_AreNoNumbers) {
    EXPECT_EQ(IcuNumberFormatter("en-GB").numberFromString("∞"), std::nullopt);
    EXPECT_EQ(IcuNumberFormatter("en-GB").numberFromString("NaN"), std::nullopt);
    EXPECT_EQ(IcuNumberFormatter("en-GB").numberFromString(std::string(400, '9')), std::nullopt);
}

TEST(IcuNumberFormatterTest, Integers_AreWrittenInTheLanguagesDigitsWithoutGrouping) {
    EXPECT_EQ(IcuNumberFormatter("ar-EG").plainStringFromInteger(1234), "١٢٣٤");
    EXPECT_EQ(IcuNumberFormatter("fa-IR").plainStringFromInteger(59), "۵۹");
    EXPECT_EQ(IcuNumberFormatter("de-CH").plainStringFromInteger(1234567), "1234567");
    EXPECT_EQ(IcuNumberFormatter("hi-IN").plainStringFromInteger(12), "12");
}

TEST(IcuNumberFormatterTest, AnUnknownLocale_StillWritesNumbers) {
    EXPECT_EQ(IcuNumberFormatter("").plainStringFromInteger(12), "12");
    EXPECT_EQ(IcuNumberFormatter("no such locale").plainStringFromInteger(12), "12");
    EXPECT_EQ(IcuNumberFormatter("no such locale").numberFromString("1.5"), 1.5);
}

TEST(IcuNumberFormatterTest, BadUtf8_IsNoNumber) {
    EXPECT_EQ(IcuNumberFormatter("en-GB").numberFromString("12\xff"), std::nullopt);
    EXPECT_EQ(IcuNumberFormatter("en-GB").numberFromString(std::string("12\0", 3)), std::nullopt);
}

}  // namespace ktr::linux_
