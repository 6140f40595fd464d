#include "linux/contacts/MemoryContactStore.h"

#include <gtest/gtest.h>

#include <set>

#include "documents/ComputingTime.h"

namespace ktr::linux_ {

namespace {

class MemoryContactStoreTest : public ::testing::Test {
  protected:
    std::shared_ptr<platform::Contact> add(const std::string& name, const std::string& phone,
                                           const std::string& identifier = "") {
        auto contact = std::make_shared<platform::Contact>();
        contact->storedFullName = name;
        contact->identifier = identifier;
        if (!phone.empty()) {
            contact->phoneNumbers.push_back({"", phone});
        }
        contacts.push_back(contact);
        return contact;
    }
    std::vector<std::string> byPhone(const std::string& number, const std::string& home = "GB") {
        MemoryContactStore store(contacts, phoneNumbers, home);
        std::vector<std::string> names;
        for (const auto& contact : store.unifiedContactsMatchingPhoneNumber(number, {}).result) {
            names.push_back(contact->storedFullName);
        }
        return names;
    }
    platform::ContactStore::Contacts contacts;
    std::shared_ptr<PhonenumberLibrary> phoneNumbers = std::make_shared<PhonenumberLibrary>();
};

using Names = std::vector<std::string>;

}  // namespace

TEST_F(MemoryContactStoreTest, Numbers_AreTheSameHoweverTheyAreWritten) {
    add("Ann", "+44 (0)1632 960001");
    add("Leila", "٠١٦٣٢ ٩٦٠٠٠٢");
    add("Noam", "01632 960003 ext. 12");
    add("Flower", "+1 800 356 9377");
    EXPECT_EQ(byPhone("01632960001"), Names{"Ann"});
    EXPECT_EQ(byPhone("+44 1632 960002"), Names{"Leila"});
    EXPECT_EQ(byPhone("tel:+441632960003"), Names{"Noam"});
    EXPECT_EQ(byPhone("1-800-FLOWERS"), Names{});
    EXPECT_EQ(byPhone("+1-800-FLOWERS"), Names{"Flower"});
}

TEST_F(MemoryContactStoreTest, LettersForDigits_AreFound) {
    add("Example", "1-800-EXAMPLE");
    add("Bikes", "(800) FIX-BIKE");
    EXPECT_EQ(byPhone("+18003926753", "US"), Names{"Example"});
    EXPECT_EQ(byPhone("(800) 392-6753", "US"), Names{"Example"});
    EXPECT_EQ(byPhone("+1 800-349-2453", "US"), Names{"Bikes"});
    EXPECT_EQ(byPhone("800 FIX BIKE", "US"), Names{"Bikes"});
}

TEST_F(MemoryContactStoreTest, ExtensionsInAnyWords_DoNotHideANumber) {
    const std::vector<std::string> written = {"01632 960003 ext. 5",
                                              "01632 960003 ext 12345",
                                              "01632 960003x5",
                                              "01632 960003 (ext: 5)",
                                              "01632 960003 доб. 5",
                                              "01632 960003 int. 5",
                                              "01632 960003 Durchwahl 5",
                                              "01632 960003, poste 5",
                                              "01632 960003 anexo 5",
                                              "01632 960003 wew. 5",
                                              "01632 960003 內線 5",
                                              "01632 960003#5",
                                              "01632 960003,,5",
                                              "01632 960003;ext=5",
                                              "tel:+44-1632-960003;ext=5",
                                              "01632 960003 extension no. 5"};
    for (const std::string& number : written) {
        contacts.clear();
        add("Noam", number);
        EXPECT_EQ(byPhone("+441632960003"), Names{"Noam"}) << number;
        contacts.clear();
        add("Noam", "+44 1632 960003");
        EXPECT_EQ(byPhone(number), Names{"Noam"}) << number;
    }
}

TEST_F(MemoryContactStoreTest, ATextThatIsNoNumber_IsComparedByItsDigits) {
    add("Desk", "*7");
    add("Other desk", "*77");
    EXPECT_EQ(byPhone("7"), Names{"Desk"});
    EXPECT_EQ(byPhone("77"), Names{"Other desk"});
    EXPECT_EQ(byPhone(""), Names{});
}

TEST_F(MemoryContactStoreTest, TheSameNumberTwice_GivesTheContactOnce) {
    add("Ann", "01632 960001")->phoneNumbers.push_back({"", "+441632960001"});
    EXPECT_EQ(byPhone("01632 960001"), Names{"Ann"});
}

TEST_F(MemoryContactStoreTest, AContactWithoutIdentifier_GetsTheSameOneAtEveryStart) {
    const auto first = add("Ann", "01632 960001");
    const auto second = add("Ben", "01632 960001");
    const MemoryContactStore store(contacts, phoneNumbers, "GB");
    EXPECT_FALSE(first->identifier.empty());
    EXPECT_NE(first->identifier, second->identifier);
    const auto again = add("Ann", "01632 960001");
    const MemoryContactStore other({again}, phoneNumbers, "GB");
    EXPECT_EQ(again->identifier, first->identifier);
}

TEST_F(MemoryContactStoreTest, ASharedIdentifier_StaysWithTheFirstContact) {
    const auto first = add("Ann", "", "1");
    const auto second = add("Ben", "", "1");
    MemoryContactStore store(contacts, phoneNumbers, "GB");
    EXPECT_EQ(store.unifiedContactWithIdentifier("1", {}).result, first);
    EXPECT_EQ(store.unifiedContactWithIdentifier("1#2", {}).result, second);
}

TEST_F(MemoryContactStoreTest, ThousandsOfTheSameContact_AreNamedAndFoundInLinearTime) {
    constexpr std::size_t kCount = 32'000;
    for (std::size_t i = 0; i < kCount; ++i) {
        add("Ann", "01632 960001")->emailAddresses.push_back({"", "ann@harbour.example"});
    }
    const auto before = documents::computingTime();
    MemoryContactStore store(contacts, phoneNumbers, "GB");
    std::set<std::string> identifiers;
    for (const auto& contact : contacts) {
        identifiers.insert(contact->identifier);
    }
    EXPECT_EQ(identifiers.size(), kCount);
    EXPECT_EQ(contacts.back()->identifier, contacts.front()->identifier + "#32000");
    // Each of them asked for: only so many are compared.
    for (std::size_t i = 0; i < kCount; ++i) {
        ASSERT_EQ(store.unifiedContactsMatchingPhoneNumber("01632 960001", {}).result.size(),
                  MemoryContactStore::kMostAlike);
        ASSERT_EQ(store.unifiedContactsMatchingEmailAddress("ann@harbour.example", {}).result.size(),
                  MemoryContactStore::kMostAlike);
    }
    // Far below what comparing each with each would take.
    EXPECT_LT(documents::computingTime() - before, std::chrono::seconds(30));
}

TEST_F(MemoryContactStoreTest, FiftyThousandContacts_AreIndexedWithoutReadingEveryNumber) {
    for (int i = 0; i < 50000; ++i) {
        add("Friend", "01632 " + std::to_string(100000 + i));
    }
    MemoryContactStore store(contacts, phoneNumbers, "GB");
    EXPECT_EQ(phoneNumbers->kept(), 0u);
    EXPECT_EQ(store.unifiedContactsMatchingPhoneNumber("+44 1632 123456", {}).result.size(), 1u);
    EXPECT_LE(phoneNumbers->kept(), 3u);
}

}  // namespace ktr::linux_
