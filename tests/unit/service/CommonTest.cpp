#include "service/Common.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::VAPerson;

class CommonTest : public PlatformTest {
  protected:
    static std::shared_ptr<VAPerson> person(const std::vector<std::optional<std::string>>& phones,
                                            const std::vector<std::optional<std::string>>& emails = {}) {
        auto made = std::make_shared<VAPerson>();
        for (const auto& number : phones) {
            made->phones.push_back(std::make_shared<platform::VAPhone>());
            made->phones.back()->number = number;
        }
        for (const auto& address : emails) {
            made->emails.push_back(std::make_shared<platform::VAEmail>());
            made->emails.back()->emailAddress = address;
        }
        return made;
    }
    void addContact(const std::string& identifier, const std::vector<std::string>& phones) {
        auto contact = std::make_shared<platform::Contact>();
        contact->identifier = identifier;
        for (const std::string& number : phones) {
            contact->phoneNumbers.push_back({"mobile", number});
        }
        contacts->contacts.push_back(contact);
    }
    static std::string complete(const std::optional<std::string>& number) {
        return Common::sharedInstance()->completeNumberForPhoneNumber(number);
    }
    static std::vector<std::string> handles(const std::shared_ptr<VAPerson>& of) {
        return Common::sharedInstance()->handlesForVAPerson(of);
    }
};

/// Remembers what it was asked, and understands nothing.
struct DeafPhoneNumbers : FakePhoneNumbers {
    mutable std::vector<std::pair<std::string, std::string>> asked;
    std::shared_ptr<platform::ParsedPhoneNumber> parse(const std::string& text,
                                                       const std::string& countryCode) const override {
        asked.emplace_back(text, countryCode);
        return nullptr;
    }
};

/// Understands every number, and prints none.
struct MutePhoneNumbers : FakePhoneNumbers {
    std::optional<std::string> text(const platform::ParsedPhoneNumber&, int) const override { return std::nullopt; }
};

TEST_F(CommonTest, OneInstanceAPlatform) {
    const auto first = Common::sharedInstance();
    EXPECT_EQ(Common::sharedInstance(), first);
    platform::Platform::install(nullptr);
    EXPECT_EQ(Common::sharedInstance(), nullptr);
}

TEST_F(CommonTest, CountryCode_HomeCountryFirst) {
    telephony->country = "us";
    region->country = "DE";
    EXPECT_EQ(Common::defaultCountryCode(), "us");
}

TEST_F(CommonTest, CountryCode_LocaleInLowerCaseWithoutAHomeCountry) {
    telephony->country = std::nullopt;
    region->country = "DE";
    EXPECT_EQ(Common::defaultCountryCode(), "de");
}

TEST_F(CommonTest, CountryCode_UsWithoutEither) {
    telephony->country = std::nullopt;
    region->country = std::nullopt;
    EXPECT_EQ(Common::defaultCountryCode(), "us");
}

TEST_F(CommonTest, AHandleWithAnAtSignIsAnEmailAddress) {
    const auto common = Common::sharedInstance();
    EXPECT_TRUE(common->isHandleEmail("ann@example.com"));
    EXPECT_TRUE(common->isHandleEmail("@"));
    EXPECT_FALSE(common->isHandleEmail("+15555550100"));
    EXPECT_FALSE(common->isHandleEmail(""));
    EXPECT_FALSE(common->isHandleEmail(std::nullopt));
}

TEST_F(CommonTest, CompleteNumber_PrintsE164ForTheDefaultCountry) {
    telephony->country = "us";
    EXPECT_EQ(complete("(555) 555-0100"), "+15555550100");
    telephony->country = "gb";
    EXPECT_EQ(complete("07700 900123"), "+447700900123");
    EXPECT_EQ(complete("+1 555 555 0100"), "+15555550100");
}

TEST_F(CommonTest, CompleteNumber_IsCutToItsFirstDigitOrMarkBeforeParsing) {
    auto deaf = std::make_shared<DeafPhoneNumbers>();
    platform->phoneNumbers = deaf;
    EXPECT_EQ(complete("mobile: (555) 010-0199"), "(555) 010-0199");
    EXPECT_EQ(complete("x+1"), "+1");
    EXPECT_EQ(complete("a)b"), ")b");
    EXPECT_EQ(complete("a*1"), "*1");
    EXPECT_EQ(complete("a#1"), "#1");
    EXPECT_EQ(complete("a-1"), "-1");
    EXPECT_EQ(complete("tel 5 ext 6"), "5 ext 6");
    EXPECT_EQ(deaf->asked.front(), (std::pair<std::string, std::string>{"(555) 010-0199", "gb"}));
}

TEST_F(CommonTest, CompleteNumber_DigitsOfEveryScriptBeginANumber) {
    auto deaf = std::make_shared<DeafPhoneNumbers>();
    platform->phoneNumbers = deaf;
    EXPECT_EQ(complete("هاتف ٠١٢٣"), "٠١٢٣");
    EXPECT_EQ(complete("電話３４"), "３４");
    EXPECT_EQ(complete("²𝟗"), "𝟗") << "a superscript is no decimal digit";
    EXPECT_EQ(complete("\xFF\xFE"
                       "12"),
              "12");
}

TEST_F(CommonTest, CompleteNumber_WithoutAnyDigitOrMarkIsParsedUnchanged) {
    auto deaf = std::make_shared<DeafPhoneNumbers>();
    platform->phoneNumbers = deaf;
    EXPECT_EQ(complete("voicemail"), "voicemail");
    EXPECT_EQ(deaf->asked.front().first, "voicemail");
}

TEST_F(CommonTest, CompleteNumber_AnEmptyOneIsNotParsed) {
    EXPECT_EQ(complete(""), "");
    EXPECT_EQ(complete(std::nullopt), "");
    EXPECT_EQ(phoneNumbers->parses, 0);
}

TEST_F(CommonTest, CompleteNumber_ThatCannotBePrintedIsPassedOnAsCut) {
    platform->phoneNumbers = std::make_shared<MutePhoneNumbers>();
    EXPECT_EQ(complete("tel 07700 900123"), "07700 900123");
}

TEST_F(CommonTest, Handles_PhonesCompletedThenEmailsAsTheyAre) {
    EXPECT_EQ(handles(person({"07700 900123", "tel 5"}, {"Ann@Example.com", "a@b"})),
              (std::vector<std::string>{"+447700900123", "5", "Ann@Example.com", "a@b"}));
}

TEST_F(CommonTest, Handles_MayHoldDuplicates) {
    EXPECT_EQ(handles(person({"07700 900123", "+447700900123"}, {"a@b", "a@b"})).size(), 4U);
}

TEST_F(CommonTest, Handles_WithoutAUsablePhoneTheContactsNumbersCount) {
    addContact("7", {"07700 900999", "", "0"});
    const auto ann = person({std::nullopt, ""}, {"a@b"});
    ann->phones.push_back(nullptr);
    ann->identifier = "assistant:7";
    EXPECT_EQ(handles(ann), (std::vector<std::string>{"+447700900999", "0", "a@b"}));
}

TEST_F(CommonTest, Handles_WithAUsablePhoneTheContactsAreNotAsked) {
    addContact("7", {"07700 900999"});
    const auto ann = person({"voicemail"});
    ann->identifier = "assistant:7";
    EXPECT_EQ(handles(ann), std::vector<std::string>{"voicemail"});
    EXPECT_EQ(contacts->fetches, 0);
}

TEST_F(CommonTest, Handles_MayBeEmpty) {
    EXPECT_TRUE(handles(person({})).empty());
    EXPECT_TRUE(handles(person({}, {std::nullopt})).empty());
    EXPECT_TRUE(handles(nullptr).empty());
    EXPECT_EQ(contacts->fetches, 0);
}

}  // namespace
}  // namespace ktr::test
