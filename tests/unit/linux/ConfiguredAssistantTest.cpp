#include "linux/configuration/ConfiguredAssistant.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

TEST(ConfiguredAssistantTest, TheLanguageIsTheGivenOne) {
    EXPECT_EQ(ConfiguredAssistant("en-GB").languageCode(), "en-GB");
    EXPECT_EQ(ConfiguredAssistant(std::nullopt).languageCode(), std::nullopt);
}

TEST(ConfiguredAssistantTest, DirectionFollowsTheScript) {
    for (const char* language : {"ar", "ar-EG", "he", "fa-IR", "ur", "az-Arab", "ks", "iw", "iw-IL", "qps-plocm"}) {
        EXPECT_TRUE(ConfiguredAssistant(language).languageIsRightToLeft()) << language;
    }
    for (const char* language : {"en", "de-CH", "ja", "az", "ar-Latn", "qps", "", "nonsense tag"}) {
        EXPECT_FALSE(ConfiguredAssistant(language).languageIsRightToLeft()) << language;
    }
    EXPECT_FALSE(ConfiguredAssistant(std::nullopt).languageIsRightToLeft());
}

}  // namespace ktr::linux_
