#include "linux/locale/HomeCountry.h"

#include <gtest/gtest.h>

#include "linux/locale/LocaleRegion.h"
#include "linux/locale/SettingsTelephony.h"

namespace ktr::linux_ {

TEST(HomeCountryTest, IsTheTelephonysThenTheLocalesThenTheUnitedStates) {
    const auto of = [](const std::optional<std::string>& telephony, const std::string& locale) {
        return HomeCountry::of(SettingsTelephony(telephony), LocaleRegion(locale));
    };
    EXPECT_EQ(of("GB", "de_DE.UTF-8"), "gb");
    EXPECT_EQ(of(std::nullopt, "de_DE.UTF-8"), "de");
    EXPECT_EQ(of(std::nullopt, "C.UTF-8"), "us");
    EXPECT_EQ(of(std::nullopt, "eo"), "us");
    EXPECT_EQ(of("nonsense", "C"), "us");
}

}  // namespace ktr::linux_
