#include "linux/locale/IcuNumberFormatter.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdint>
#include <random>
#include <string>

#include <unicode/locid.h>
#include <unicode/numberformatter.h>

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

// Numbers are put together from digits: they must stay what the library writes.
TEST(IcuNumberFormatterTest, Integers_AreWrittenAsTheLibraryWritesThem) {
    std::mt19937_64 random(7);
    for (const char* tag : {"ar-EG", "bn-BD", "de-CH", "en-GB", "fa-IR", "hi-IN-u-nu-deva", "my-MM", "zh-TW",
                            "zh-u-nu-hanidec", "zh-u-nu-hans", "he-u-nu-hebr", "en-u-nu-roman", "ta-u-nu-taml"}) {
        UErrorCode status = U_ZERO_ERROR;
        const auto library = icu::number::NumberFormatter::withLocale(icu::Locale::forLanguageTag(tag, status))
                                 .grouping(UNUM_GROUPING_OFF)
                                 .precision(icu::number::Precision::integer());
        const IcuNumberFormatter numbers(tag);
        for (int i = 0; i < 200; ++i) {
            const auto number = static_cast<std::int64_t>(random() >> (i % 64)) * (i % 5 == 0 ? -1 : 1);
            std::string expected;
            library.formatInt(number, status).toString(status).toUTF8String(expected);
            ASSERT_TRUE(U_SUCCESS(status)) << tag;
            ASSERT_EQ(numbers.plainStringFromInteger(number), expected) << tag << ", " << number;
        }
    }
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
