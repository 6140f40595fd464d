#include "linux/contacts/ScriptContactFormatter.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

namespace {

class ScriptContactFormatterTest : public ::testing::Test {
  protected:
    std::optional<std::string> name() const {
        return formatter.stringFromContact(contact, platform::ContactFormatterStyle::FullName);
    }
    platform::Contact contact;
    ScriptContactFormatter formatter;
};

}  // namespace

TEST_F(ScriptContactFormatterTest, AStoredName_IsTakenAsItIs) {
    contact.storedFullName = "Captain Marsh";
    contact.givenName = "Ann";
    EXPECT_EQ(name(), "Captain Marsh");
}

TEST_F(ScriptContactFormatterTest, Parts_StandInTheirOrder) {
    contact.namePrefix = "Dr.";
    contact.givenName = "Ann";
    contact.middleName = "Jo";
    contact.familyName = "Marsh";
    contact.nameSuffix = "jr.";
    EXPECT_EQ(name(), "Dr. Ann Jo Marsh jr.");
}

TEST_F(ScriptContactFormatterTest, OnePart_StandsAlone) {
    contact.familyName = "Marsh";
    EXPECT_EQ(name(), "Marsh");
}

TEST_F(ScriptContactFormatterTest, HanKanaAndHangul_HaveTheFamilyFirst) {
    contact.familyName = "佐藤";
    contact.givenName = "美咲";
    EXPECT_EQ(name(), "佐藤美咲");
    contact.givenName = "みさき";
    EXPECT_EQ(name(), "佐藤みさき");
    contact.familyName = "강";
    contact.givenName = "민서";
    EXPECT_EQ(name(), "강민서");
}

TEST_F(ScriptContactFormatterTest, MixedScripts_HaveTheGivenNameFirst) {
    contact.familyName = "佐藤";
    contact.givenName = "Misaki";
    EXPECT_EQ(name(), "Misaki 佐藤");
}

TEST_F(ScriptContactFormatterTest, ArabicAndHebrew_HaveTheGivenNameFirst) {
    contact.familyName = "حداد";
    contact.givenName = "ليلى";
    EXPECT_EQ(name(), "ليلى حداد");
}

TEST_F(ScriptContactFormatterTest, WithoutAName_NicknameThenOrganizationThenNone) {
    EXPECT_EQ(name(), std::nullopt);
    contact.organizationName = "Harbour Office";
    EXPECT_EQ(name(), "Harbour Office");
    contact.nickname = "Annie";
    EXPECT_EQ(name(), "Annie");
}

}  // namespace ktr::linux_
