#include "linux/contacts/PhonenumberLibrary.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

namespace {

class PhonenumberLibraryTest : public ::testing::Test {
  protected:
    std::optional<std::string> shown(const std::string& text, const std::string& country, const std::string& home) {
        const auto number = library.parse(text, country);
        return number ? library.displayText(*number, PhonenumberLibrary::kDisplayStyle, home) : std::nullopt;
    }
    PhonenumberLibrary library;
};

}  // namespace

TEST_F(PhonenumberLibraryTest, Display_IsNationalForTheHomeCountry) {
    EXPECT_EQ(shown("+441632960018", "gb", "gb"), "01632 960018");
    EXPECT_EQ(shown("+441632960018", "us", "us"), "+44 1632 960018");
    EXPECT_EQ(shown("5555550100", "us", "US"), "(555) 555-0100");
}

TEST_F(PhonenumberLibraryTest, CountriesOfOneCallingCode_WriteEachOthersNumbersNationally) {
    EXPECT_EQ(shown("+15555550100", "us", "ca"), "(555) 555-0100");
}

TEST_F(PhonenumberLibraryTest, WithoutAHomeCountry_DisplayIsInternational) {
    EXPECT_EQ(shown("+441632960018", "", ""), "+44 1632 960018");
}

TEST_F(PhonenumberLibraryTest, NumbersNotInUse_CountAsNumbers) {
    EXPECT_EQ(shown("+1 555 010 0139", "us", "gb"), "+1 555-010-0139");
}

TEST_F(PhonenumberLibraryTest, ArabicDigitsAndSchemes_AreRead) {
    const auto number = library.parse("tel:+٤٤١٦٣٢٩٦٠٠١٨", "us");
    ASSERT_NE(number, nullptr);
    EXPECT_EQ(library.text(*number, PhonenumberLibrary::kFormatE164), "+441632960018");
}

TEST_F(PhonenumberLibraryTest, Parts_SayWhetherTheNumberWasComplete) {
    const auto complete = library.parts("+44 1632 960018", "us");
    const auto national = library.parts("01632 960018", "gb");
    ASSERT_TRUE(complete && national);
    EXPECT_TRUE(complete->complete);
    EXPECT_FALSE(national->complete);
    EXPECT_EQ(complete->nationalPart, "1632960018");
    EXPECT_EQ(national->e164, complete->e164);
    EXPECT_EQ(national->callingCode, "44");
}

TEST_F(PhonenumberLibraryTest, Answers_AreKeptWithinABound) {
    EXPECT_EQ(library.parse("+441632960018", "gb"), library.parse("+441632960018", "GB"));
    for (std::size_t i = 0; i < 2 * PhonenumberLibrary::kKept; ++i) {
        library.parse("+4416329" + std::to_string(10000 + i), "gb");
    }
    EXPECT_EQ(library.kept(), PhonenumberLibrary::kKept);
}

TEST_F(PhonenumberLibraryTest, AnAnswerAskedForAgain_IsNotTheNextToGo) {
    const auto first = library.parse("+441632960018", "gb");
    for (std::size_t i = 0; i < PhonenumberLibrary::kKept - 1; ++i) {
        library.parse("+4416329" + std::to_string(10000 + i), "gb");
    }
    EXPECT_EQ(library.parse("+441632960018", "gb"), first);
    library.parse("+441632999999", "gb");
    EXPECT_EQ(library.parse("+441632960018", "gb"), first);
}

TEST_F(PhonenumberLibraryTest, AnAnswerThatWasGivenUp_StaysUsable) {
    const auto number = library.parse("+441632960018", "gb");
    for (std::size_t i = 0; i < 2 * PhonenumberLibrary::kKept; ++i) {
        library.parse("no number " + std::to_string(i), "gb");
    }
    EXPECT_EQ(library.text(*number, PhonenumberLibrary::kFormatE164), "+441632960018");
}

TEST_F(PhonenumberLibraryTest, HugeTexts_AreNoNumbers) {
    EXPECT_EQ(library.parse(std::string(100000, '1'), "gb"), nullptr);
    EXPECT_EQ(library.parse("\xff\xfe+44\xff", "gb"), nullptr);
}

TEST_F(PhonenumberLibraryTest, ANumberOfAnotherLibrary_CannotBePrinted) {
    const platform::ParsedPhoneNumber foreign;
    EXPECT_EQ(library.displayText(foreign, PhonenumberLibrary::kDisplayStyle, "gb"), std::nullopt);
    EXPECT_EQ(library.text(foreign, PhonenumberLibrary::kFormatE164), std::nullopt);
}

}  // namespace ktr::linux_
