#include "tests/contract/LocalizationContract.h"

#include "tests/support/Doubles.h"

namespace ktr::test {

TEST_P(LocalizationContract, TheAssistantsLanguageComesFirst) {
    EXPECT_EQ(localization->text("BOTH", kBundle), "Beides");
    EXPECT_EQ(localization->text("GERMAN", kBundle), "Nur deutsch");
}

TEST_P(LocalizationContract, AMissingText_FallsBackToEnglish) {
    EXPECT_EQ(localization->text("ENGLISH", kBundle), "English only");
    EXPECT_EQ(localization->text("_$!<home>!$_", kBundle), "Home");
    EXPECT_EQ(localization->text("ENGLISH", kBundle, std::nullopt, "default"), "English only");
}

TEST_P(LocalizationContract, AnUnknownKey_GivesTheDefaultElseTheKey) {
    EXPECT_EQ(localization->text("UNKNOWN", kBundle, std::nullopt, "default"), "default");
    EXPECT_EQ(localization->text("UNKNOWN", kBundle, std::nullopt, ""), "");
    EXPECT_EQ(localization->text("UNKNOWN", kBundle), "UNKNOWN");
}

TEST_P(LocalizationContract, KeysAreToldApartByCase) {
    EXPECT_EQ(localization->text("_$!<HOME>!$_", kBundle), "_$!<HOME>!$_");
}

TEST_P(LocalizationContract, AnotherBundleOrTable_HasNoneOfTheTexts) {
    EXPECT_EQ(localization->text("BOTH", "org.other"), "BOTH");
    EXPECT_EQ(localization->text("BOTH", kBundle, "Other"), "BOTH");
    EXPECT_EQ(localization->text("BOTH", localization->hostBundleIdentifier()), "BOTH");
}

INSTANTIATE_TEST_SUITE_P(FakeLocalization, LocalizationContract,
                         ::testing::Values(LocalizationCase{"FakeLocalization",
                                                            [](const LocalizationTexts& texts) {
                                                                auto made = std::make_shared<FakeLocalization>();
                                                                made->language = "de";
                                                                for (const auto& [language, entries] : texts) {
                                                                    for (const auto& [key, text] : entries) {
                                                                        made->set("org.example", key, text, language);
                                                                    }
                                                                }
                                                                return made;
                                                            }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
