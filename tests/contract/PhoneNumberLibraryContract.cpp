#include "tests/contract/PhoneNumberLibraryContract.h"

#include "tests/support/Doubles.h"

namespace ktr::test {

TEST_P(PhoneNumberLibraryContract, ACompleteNumber_IsReadWhateverTheCountry) {
    EXPECT_EQ(e164("+44 1632 960018", "us"), "+441632960018");
    EXPECT_EQ(e164("+44 (1632) 960-018", "gb"), "+441632960018");
}

TEST_P(PhoneNumberLibraryContract, ANationalNumber_IsCompletedFromTheCountry) {
    EXPECT_EQ(e164("01632 960018", "gb"), "+441632960018");
    EXPECT_EQ(e164("(555) 555-0100", "us"), "+15555550100");
}

TEST_P(PhoneNumberLibraryContract, CountryCodes_AreReadInEitherCase) {
    EXPECT_EQ(e164("01632 960018", "GB"), "+441632960018");
    EXPECT_EQ(e164("(555) 555-0100", "US"), "+15555550100");
}

TEST_P(PhoneNumberLibraryContract, WhatIsNoNumber_GivesNone) {
    EXPECT_EQ(library->parse("", "gb"), nullptr);
    EXPECT_EQ(library->parse("hello", "gb"), nullptr);
    EXPECT_EQ(library->parse("ann@harbour.example", "gb"), nullptr);
}

TEST_P(PhoneNumberLibraryContract, ANationalNumberOfAnUnknownCountry_GivesNone) {
    EXPECT_EQ(library->parse("01632 960018", "zz"), nullptr);
    EXPECT_EQ(library->parse("01632 960018", ""), nullptr);
}

TEST_P(PhoneNumberLibraryContract, Display_IsNationalAtHomeAndInternationalElsewhere) {
    EXPECT_EQ(displayedDigits("+441632960018", "gb"), "01632960018");
    EXPECT_EQ(displayedDigits("+441632960018", "us"), "+441632960018");
}

TEST_P(PhoneNumberLibraryContract, OtherStylesAndFormats_GiveNone) {
    const auto number = library->parse("+441632960018", "gb");
    ASSERT_NE(number, nullptr);
    EXPECT_EQ(library->displayText(*number, 7, "gb"), std::nullopt);
    EXPECT_EQ(library->text(*number, 9), std::nullopt);
}

INSTANTIATE_TEST_SUITE_P(FakePhoneNumbers, PhoneNumberLibraryContract,
                         ::testing::Values(PhoneNumberLibraryCase{"FakePhoneNumbers",
                                                                  [] { return std::make_shared<FakePhoneNumbers>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
