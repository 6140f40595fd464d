#include "linux/locale/LocaleRegion.h"

#include <gtest/gtest.h>

#include "tests/support/EnvironmentVariable.h"

namespace ktr::linux_ {

TEST(LocaleRegionTest, PosixAndLanguageTags_AreRead) {
    EXPECT_EQ(LocaleRegion("de_CH.UTF-8").localeIdentifier(), "de-CH");
    EXPECT_EQ(LocaleRegion("de_CH.UTF-8").countryCode(), "CH");
    EXPECT_EQ(LocaleRegion("sr_RS@latin").countryCode(), "RS");
    EXPECT_EQ(LocaleRegion("zh-Hant-TW").localeIdentifier(), "zh-Hant-TW");
    EXPECT_EQ(LocaleRegion("zh-Hant-TW").countryCode(), "TW");
    EXPECT_EQ(LocaleRegion("en-US-u-ms-metric").localeIdentifier(), "en-US-u-ms-metric");
}

TEST(LocaleRegionTest, ALocaleWithoutACountry_HasNone) {
    EXPECT_EQ(LocaleRegion("eo").countryCode(), std::nullopt);
    EXPECT_EQ(LocaleRegion("es-419").countryCode(), std::nullopt);
    EXPECT_EQ(LocaleRegion("C").countryCode(), std::nullopt);
    EXPECT_EQ(LocaleRegion("").localeIdentifier(), "en");
    EXPECT_EQ(LocaleRegion("C.UTF-8").localeIdentifier(), "en");
    EXPECT_EQ(LocaleRegion("!!").localeIdentifier(), "en");
}

TEST(LocaleRegionTest, LocaleWithLanguage_TakesTheLanguageAndScriptAndKeepsTheCountry) {
    EXPECT_EQ(LocaleRegion("en-GB").localeWithLanguage("ar-EG"), "ar-GB");
    EXPECT_EQ(LocaleRegion("ar-EG").localeWithLanguage("de"), "de-EG");
    EXPECT_EQ(LocaleRegion("en-US-u-ms-metric").localeWithLanguage("zh-Hant"), "zh-Hant-US");
    EXPECT_EQ(LocaleRegion("eo").localeWithLanguage("de-AT"), "de-AT");
    EXPECT_EQ(LocaleRegion("de-CH").localeWithLanguage(""), "de-CH");
    EXPECT_EQ(LocaleRegion("de-CH").localeWithLanguage("no tag at all"), "de-CH");
}

TEST(LocaleRegionTest, TheSessionsLocale_IsTheFirstThatIsSet) {
    const test::EnvironmentVariable all("LC_ALL", nullptr);
    const test::EnvironmentVariable measures("LC_MEASUREMENT", "de_AT.UTF-8");
    const test::EnvironmentVariable messages("LC_MESSAGES", "");
    const test::EnvironmentVariable lang("LANG", "ar_EG.UTF-8");
    EXPECT_EQ(LocaleRegion::sessionLocale(), "de-AT");
    EXPECT_EQ(LocaleRegion::sessionLanguage(), "ar-EG");
    const test::EnvironmentVariable every("LC_ALL", "C");
    EXPECT_EQ(LocaleRegion::sessionLocale(), "en");
    EXPECT_EQ(LocaleRegion::sessionLanguage(), "en");
}

}  // namespace ktr::linux_
