#include "linux/contacts/PrefixedAssistantContacts.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

TEST(PrefixedAssistantContactsTest, Identifiers_ConvertBothWays) {
    const PrefixedAssistantContacts conversion;
    platform::Contact contact;
    contact.identifier = "ann-marsh";
    EXPECT_EQ(conversion.assistantIdentifierForContact(contact), "x-assistant-contact:ann-marsh");
    EXPECT_EQ(conversion.contactIdentifierForAssistantIdentifier("x-assistant-contact:ann-marsh"), "ann-marsh");
}

TEST(PrefixedAssistantContactsTest, WhatIsNotTheAssistants_GivesNone) {
    const PrefixedAssistantContacts conversion;
    for (const char* other : {"", "ann-marsh", "x-assistant-contact:", "X-Assistant-Contact:ann"}) {
        EXPECT_EQ(conversion.contactIdentifierForAssistantIdentifier(other), std::nullopt) << other;
    }
    EXPECT_EQ(conversion.assistantIdentifierForContact({}), std::nullopt);
}

TEST(PrefixedAssistantContactsTest, TheConversionNeedsTheIdentifier) {
    EXPECT_EQ(PrefixedAssistantContacts().requiredKeys(), platform::ContactKeys{"identifier"});
}

}  // namespace ktr::linux_
