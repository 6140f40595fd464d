#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/contacts/ContactStore.h"

namespace ktr::test {

struct ContactStoreCase {
    std::string name;
    /// A store of these contacts, in this order; the home country is the United Kingdom.
    std::function<std::shared_ptr<platform::ContactStore>(const platform::ContactStore::Contacts& contacts)> make;
};

class ContactStoreContract : public ::testing::TestWithParam<ContactStoreCase> {
  protected:
    void SetUp() override {
        add("ann", "Ann Marsh", {"ann@harbour.example", "marsh@mail.example"}, {"+44 1632 960001"});
        add("noam", "נועם ברק", {"N.Barak@Harbour.example"}, {"01632 960002"});
        add("twin", "Ann’s desk", {"ANN@harbour.example"}, {"+44 (1632) 960-001", "+1 632 960 0018"});
        store = GetParam().make(contacts);
    }
    void add(const std::string& identifier, const std::string& name, const std::vector<std::string>& emails,
             const std::vector<std::string>& phones) {
        auto contact = std::make_shared<platform::Contact>();
        contact->identifier = identifier;
        contact->storedFullName = name;
        for (const auto& email : emails) {
            contact->emailAddresses.push_back({"", email});
        }
        for (const auto& phone : phones) {
            contact->phoneNumbers.push_back({"", phone});
        }
        contacts.push_back(contact);
    }
    static std::vector<std::string> identifiers(const platform::ContactFetch<platform::ContactStore::Contacts>& fetch) {
        EXPECT_EQ(fetch.error, std::nullopt);
        std::vector<std::string> out;
        for (const auto& contact : fetch.result) {
            out.push_back(contact->identifier);
        }
        return out;
    }
    std::vector<std::string> byEmail(const std::string& address) {
        return identifiers(store->unifiedContactsMatchingEmailAddress(address, {}));
    }
    std::vector<std::string> byPhone(const std::string& number) {
        return identifiers(store->unifiedContactsMatchingPhoneNumber(number, {}));
    }

    platform::ContactStore::Contacts contacts;
    std::shared_ptr<platform::ContactStore> store;
};

}  // namespace ktr::test
