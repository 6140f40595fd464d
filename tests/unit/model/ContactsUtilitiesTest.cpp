#include "model/ContactsUtilities.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Contact;

platform::Bytes bytes(const std::string& text) {
    return {text.begin(), text.end()};
}

class ContactsUtilitiesTest : public PlatformTest {
  protected:
    std::shared_ptr<Contact> add(const std::string& identifier, const std::string& email, const std::string& phone,
                                 bool pictured = false) {
        auto contact = std::make_shared<Contact>();
        contact->identifier = identifier;
        contact->emailAddresses.push_back({"home", email});
        contact->phoneNumbers.push_back({"mobile", phone});
        if (pictured) {
            contact->imageData = bytes("image");
        }
        contacts->contacts.push_back(contact);
        return contact;
    }
    FakeMonogramMakers::Call& lastMaker() { return *monogramMakers->calls.back(); }
};

TEST_F(ContactsUtilitiesTest, TheStoreIsThePlatformsOne) {
    EXPECT_EQ(ContactsUtilities::contactStore(), contacts);
}

TEST_F(ContactsUtilitiesTest, KeysAreTheFormattersThirtyFixedOnesAndTheConversions) {
    const auto keys = ContactsUtilities::contactKeys();
    const platform::ContactKeys expected = {"fullNameKeys",
                                            "namePrefix",
                                            "givenName",
                                            "middleName",
                                            "familyName",
                                            "previousFamilyName",
                                            "nameSuffix",
                                            "nickname",
                                            "phoneticGivenName",
                                            "phoneticMiddleName",
                                            "organizationName",
                                            "departmentName",
                                            "jobTitle",
                                            "birthday",
                                            "nonGregorianBirthday",
                                            "note",
                                            "cropRect",
                                            "imageData",
                                            "thumbnailImageData",
                                            "preferredLikenessSource",
                                            "preferredPersonaIdentifier",
                                            "imageDataAvailable",
                                            "contactType",
                                            "phoneNumbers",
                                            "emailAddresses",
                                            "postalAddresses",
                                            "dates",
                                            "urlAddresses",
                                            "contactRelations",
                                            "socialProfiles",
                                            "instantMessageAddresses",
                                            "conversionKey"};
    EXPECT_EQ(keys, expected);
    EXPECT_EQ(keys.size(), 31U + 1U);
}

TEST_F(ContactsUtilitiesTest, EveryFetchAsksForTheKeys) {
    const auto keys = ContactsUtilities::contactKeys();
    ContactsUtilities::contactForEmail("a@b");
    EXPECT_EQ(contacts->lastKeys, keys);
    contacts->lastKeys.clear();
    ContactsUtilities::contactForPhone("07700 900123");
    EXPECT_EQ(contacts->lastKeys, keys);
    contacts->lastKeys.clear();
    expectErrorLine("Could not find contact for assistant ID assistant:1 : no contact with this identifier");
    ContactsUtilities::contactForAssistantId("assistant:1");
    EXPECT_EQ(contacts->lastKeys, keys);
}

TEST_F(ContactsUtilitiesTest, KeysOfAThousandFetches_AreMadeOnce) {
    struct CountingFormatter : FakeContactFormatter {
        std::string descriptorForRequiredKeys(platform::ContactFormatterStyle style) const override {
            ++asked;
            return FakeContactFormatter::descriptorForRequiredKeys(style);
        }
        mutable int asked = 0;
    };
    const auto formatter = std::make_shared<CountingFormatter>();
    platform::Platform::installed()->contactFormatter = formatter;
    for (int i = 0; i < 1000; ++i) {
        ContactsUtilities::contactForEmail("a@b");
    }
    EXPECT_EQ(formatter->asked, 1);
}

TEST_F(ContactsUtilitiesTest, ByEmail_TheFirstWithAPictureWins) {
    add("1", "ann@example.com", "1");
    const auto pictured = add("2", "Ann@Example.com", "2", true);
    add("3", "ann@example.com", "3", true);
    EXPECT_EQ(ContactsUtilities::contactForEmail("ann@example.com"), pictured);
}

TEST_F(ContactsUtilitiesTest, ByEmail_WithoutAnyPictureTheFirstWins) {
    const auto first = add("1", "ann@example.com", "1");
    add("2", "ann@example.com", "2");
    EXPECT_EQ(ContactsUtilities::contactForEmail("ann@example.com"), first);
    EXPECT_EQ(ContactsUtilities::contactForEmail("bob@example.com"), nullptr);
}

TEST_F(ContactsUtilitiesTest, ByPhone_MatchesHoweverTheNumberIsWritten) {
    const auto ann = add("1", "ann@example.com", "07700 900123");
    EXPECT_EQ(ContactsUtilities::contactForPhone("+447700900123"), ann);
    EXPECT_EQ(ContactsUtilities::contactForPhone("07700 900124"), nullptr);
}

TEST_F(ContactsUtilitiesTest, AnEmptyHandleDoesNotTouchTheStore) {
    EXPECT_EQ(ContactsUtilities::contactForEmail(""), nullptr);
    EXPECT_EQ(ContactsUtilities::contactForPhone(""), nullptr);
    EXPECT_EQ(ContactsUtilities::contactForEmail(std::nullopt), nullptr);
    EXPECT_EQ(ContactsUtilities::contactForPhone(std::nullopt), nullptr);
    EXPECT_EQ(contacts->fetches, 0);
}

TEST_F(ContactsUtilitiesTest, WithoutAStoreNobodyIsFound) {
    platform->contactStore = nullptr;
    EXPECT_EQ(ContactsUtilities::contactForEmail("a@b"), nullptr);
    EXPECT_EQ(ContactsUtilities::contactForPhone("1"), nullptr);
    EXPECT_EQ(ContactsUtilities::contactForAssistantId("assistant:1"), nullptr);
}

TEST_F(ContactsUtilitiesTest, FetchErrorsByHandleStaySilent) {
    contacts->error = "denied";
    EXPECT_EQ(ContactsUtilities::contactForEmail("a@b"), nullptr);
    EXPECT_EQ(ContactsUtilities::contactForPhone("1"), nullptr);
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(ContactsUtilitiesTest, ByAssistantId_ConvertsTheIdentifier) {
    const auto ann = add("7", "ann@example.com", "1");
    EXPECT_EQ(ContactsUtilities::contactForAssistantId("assistant:7"), ann);
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(ContactsUtilitiesTest, ByAssistantId_WhatIsNoIdentifierDoesNotTouchTheStore) {
    EXPECT_EQ(ContactsUtilities::contactForAssistantId("7"), nullptr);
    EXPECT_EQ(ContactsUtilities::contactForAssistantId(std::nullopt), nullptr);
    EXPECT_EQ(contacts->fetches, 0);
}

TEST_F(ContactsUtilitiesTest, ByAssistantId_AFailedFetchIsAnErrorLine) {
    expectErrorLine("Could not find contact for assistant ID assistant:7 : denied");
    contacts->error = "denied";
    EXPECT_EQ(ContactsUtilities::contactForAssistantId("assistant:7"), nullptr);
    ASSERT_EQ(log->lines().size(), 1U);
    EXPECT_EQ(log->lines()[0].level, platform::LogLevel::Error);
    EXPECT_EQ(log->lines()[0].format, "Could not find contact for assistant ID %@ : %@");
}

TEST_F(ContactsUtilitiesTest, TheOptimalContactOfNoneIsNone) {
    EXPECT_EQ(ContactsUtilities::findOptimalContactInContacts({}), nullptr);
}

TEST_F(ContactsUtilitiesTest, TheOptimalContactNeedsImageDataNotAThumbnail) {
    const auto first = add("1", "a", "1");
    const auto second = add("2", "a", "2");
    second->thumbnailImageData = bytes("image");
    EXPECT_EQ(ContactsUtilities::findOptimalContactInContacts({first, second}), first);
}

TEST_F(ContactsUtilitiesTest, PhoneNumbersInTheContactsOrder) {
    const auto ann = add("1", "a", "2");
    ann->phoneNumbers.push_back({"home", "1"});
    EXPECT_EQ(ContactsUtilities::phoneNumbersForContact(ann), (std::vector<std::string>{"2", "1"}));
    EXPECT_TRUE(ContactsUtilities::phoneNumbersForContact(nullptr).empty());
}

TEST_F(ContactsUtilitiesTest, PicturesAreMadeOfTheThumbnailAlone) {
    const auto ann = add("1", "a", "2", true);
    EXPECT_EQ(ContactsUtilities::imageForContact(nullptr), nullptr);
    EXPECT_EQ(ContactsUtilities::imageForContact(ann), nullptr) << "the full-size data does not count";
    ann->thumbnailImageData = bytes("image small");
    const auto image = std::dynamic_pointer_cast<FakeImage>(ContactsUtilities::imageForContact(ann));
    ASSERT_TRUE(image);
    EXPECT_EQ(image->name, "image small");
    ann->thumbnailImageData = bytes("broken");
    EXPECT_EQ(ContactsUtilities::imageForContact(ann), nullptr);
}

TEST_F(ContactsUtilitiesTest, DiameterForSize) {
    const std::vector<double> expected = {42.0, 58.0, 72.0, 89.0, 89.0, 0.0, 0.0};
    for (unsigned size = 0; size < expected.size(); ++size) {
        EXPECT_EQ(ContactsUtilities::diameterForSize(size), expected[size]) << size;
    }
    EXPECT_EQ(ContactsUtilities::diameterForSize(static_cast<unsigned>(-1)), 0.0);
}

TEST_F(ContactsUtilitiesTest, Monogram_UsesTheSizesDiameterAndFont) {
    const auto ann = add("1", "a", "2");
    const std::vector<double> fonts = {19.0, 27.0, 41.0, 50.0, 38.0};
    for (unsigned size = 0; size < fonts.size(); ++size) {
        ContactsUtilities::monogramForContact(ann, size, std::nullopt);
        EXPECT_EQ(lastMaker().style, 1);
        EXPECT_EQ(lastMaker().diameter, ContactsUtilities::diameterForSize(size));
        EXPECT_EQ(lastMaker().font,
                  (platform::Font{platform::FontFace::Rounded, platform::FontWeight::Semibold, fonts[size]}));
    }
}

TEST_F(ContactsUtilitiesTest, Monogram_OfAnotherSizeKeepsTheMakersFont) {
    ContactsUtilities::monogramForContact(add("1", "a", "2"), 5, std::nullopt);
    EXPECT_EQ(lastMaker().diameter, 0.0);
    EXPECT_EQ(lastMaker().font, std::nullopt);
}

TEST_F(ContactsUtilitiesTest, Monogram_TheOverrideColourDoesNotShow_IsKept) {
    const auto red = platform::Color::rgb(1.0, 0.0, 0.0);
    const auto image =
        std::dynamic_pointer_cast<FakeImage>(ContactsUtilities::monogramForContact(add("1", "a", "2"), 0, red));
    ASSERT_TRUE(image);
    EXPECT_EQ(image->name, "monogram 1");
    EXPECT_EQ(lastMaker().tintsAsked, (std::vector<std::optional<platform::Color>>{red}));
}

TEST_F(ContactsUtilitiesTest, Monogram_OfNobodyIsTheEmptyContacts) {
    const auto image =
        std::dynamic_pointer_cast<FakeImage>(ContactsUtilities::monogramForContact(nullptr, 0, std::nullopt));
    ASSERT_TRUE(image);
    EXPECT_EQ(image->name, "monogram ");
}

}  // namespace
}  // namespace ktr::test
