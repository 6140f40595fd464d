#include "linux/locale/SettingsTelephony.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

TEST(SettingsTelephonyTest, TwoLetters_AreTheHomeCountry) {
    EXPECT_EQ(SettingsTelephony("gb").homeCountryCode(), "gb");
    EXPECT_EQ(SettingsTelephony("GB").homeCountryCode(), "GB");
}

TEST(SettingsTelephonyTest, AnythingElse_IsNone) {
    for (const char* other : {"", "g", "gbr", "1a", "é", "  "}) {
        EXPECT_EQ(SettingsTelephony(other).homeCountryCode(), std::nullopt) << other;
    }
    EXPECT_EQ(SettingsTelephony(std::nullopt).homeCountryCode(), std::nullopt);
}

}  // namespace ktr::linux_
