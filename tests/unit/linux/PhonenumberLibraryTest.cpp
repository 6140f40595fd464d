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
    static constexpr std::size_t kFew = 512;
    PhonenumberLibrary library;
    PhonenumberLibrary few{kFew};
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
    EXPECT_EQ(few.parse("+441632960018", "gb"), few.parse("+441632960018", "GB"));
    for (std::size_t i = 0; i < 2 * kFew; ++i) {
        few.parse("+4416329" + std::to_string(10000 + i), "gb");
    }
    EXPECT_EQ(few.kept(), kFew);
}

TEST_F(PhonenumberLibraryTest, TenThousandFriendsWithTwoNumbers_AreReadOnce) {
    const auto poll = [this] {
        for (int i = 0; i < 10'000; ++i) {
            library.parse("+4416329" + std::to_string(10'000 + i), "gb");
            library.parse("+4416328" + std::to_string(10'000 + i), "gb");
        }
    };
    poll();
    EXPECT_EQ(library.read(), 20'000U);
    poll();
    EXPECT_EQ(library.read(), 20'000U);
}

TEST_F(PhonenumberLibraryTest, AListThatIsALittleTooLong_LosesALittle) {
    constexpr std::size_t kCount = kFew * 5 / 4;
    const auto poll = [&] {
        const std::size_t before = few.read();
        for (std::size_t i = 0; i < kCount; ++i) {
            few.parse("no number " + std::to_string(i), "gb");
        }
        return few.read() - before;
    };
    EXPECT_EQ(poll(), kCount);
    poll();
    EXPECT_LT(poll(), kCount * 3 / 4);
    EXPECT_EQ(few.kept(), kFew);
}

TEST_F(PhonenumberLibraryTest, AnAnswerAskedForAgain_IsNotTheNextToGo) {
    const auto fill = [&](std::size_t from, std::size_t count) {
        for (std::size_t i = 0; i < count; ++i) {
            few.parse("no number " + std::to_string(from + i), "gb");
        }
    };
    few.parse("+441632960018", "gb");
    fill(0, kFew - 1);
    for (std::size_t round = 0; round < 200; ++round) {
        const std::size_t before = few.read();
        few.parse("+441632960018", "gb");
        EXPECT_EQ(few.read(), before);
        fill((round + 2) * kFew, 1);
    }
}

TEST_F(PhonenumberLibraryTest, AnAnswerThatWasGivenUp_StaysUsable) {
    const auto number = few.parse("+441632960018", "gb");
    for (std::size_t i = 0; i < 2 * kFew; ++i) {
        few.parse("no number " + std::to_string(i), "gb");
    }
    EXPECT_EQ(few.text(*number, PhonenumberLibrary::kFormatE164), "+441632960018");
}

TEST_F(PhonenumberLibraryTest, ExtensionsInOtherWords_AreLeftOut) {
    for (const char* text : {"01632 960018 ext. 5", "01632 960018 x5", "01632 960018 Durchwahl 5",
                             "01632 960018 poste 5", "01632 960018 доб. 5", "01632 960018 wew. 5"}) {
        const auto parts = library.parts(text, "gb");
        ASSERT_TRUE(parts) << text;
        EXPECT_EQ(parts->e164, "+441632960018") << text;
    }
    EXPECT_EQ(shown("+441632960018 ext. 5", "gb", "gb"), "01632 960018 x5");
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
