#include "tests/contract/ContactStoreContract.h"

#include "tests/support/Doubles.h"

namespace ktr::test {

using Identifiers = std::vector<std::string>;

TEST_P(ContactStoreContract, Email_IsFoundWhateverTheCaseInTheStoresOrder) {
    EXPECT_EQ(byEmail("ann@harbour.example"), (Identifiers{"ann", "twin"}));
    EXPECT_EQ(byEmail("Ann@Harbour.Example"), (Identifiers{"ann", "twin"}));
    EXPECT_EQ(byEmail("n.barak@harbour.example"), (Identifiers{"noam"}));
}

TEST_P(ContactStoreContract, EveryAddressOfAContactCounts) {
    EXPECT_EQ(byEmail("marsh@mail.example"), (Identifiers{"ann"}));
}

TEST_P(ContactStoreContract, UnknownHandles_FindNobodyWithoutAnError) {
    EXPECT_EQ(byEmail("nobody@mail.example"), Identifiers{});
    EXPECT_EQ(byEmail("harbour.example"), Identifiers{});
    EXPECT_EQ(byPhone("+44 1632 960999"), Identifiers{});
    EXPECT_EQ(byPhone("no number"), Identifiers{});
}

TEST_P(ContactStoreContract, CompleteNumbers_AreComparedInFull) {
    EXPECT_EQ(byPhone("+441632960001"), (Identifiers{"ann", "twin"}));
    EXPECT_EQ(byPhone("+16329600018"), (Identifiers{"twin"}));
    EXPECT_EQ(byPhone("+49 1632 960001"), Identifiers{});
}

TEST_P(ContactStoreContract, IncompleteNumbers_AreComparedByTheirNationalPart) {
    EXPECT_EQ(byPhone("+44 1632 960002"), (Identifiers{"noam"}));
    EXPECT_EQ(byPhone("01632960002"), (Identifiers{"noam"}));
    EXPECT_EQ(byPhone("01632 960001"), (Identifiers{"ann", "twin"}));
}

TEST_P(ContactStoreContract, Identifier_FindsItsContact) {
    const auto fetch = store->unifiedContactWithIdentifier("noam", {});
    EXPECT_EQ(fetch.error, std::nullopt);
    ASSERT_NE(fetch.result, nullptr);
    EXPECT_EQ(fetch.result->storedFullName, "נועם ברק");
}

TEST_P(ContactStoreContract, UnknownIdentifier_IsAnError) {
    const auto fetch = store->unifiedContactWithIdentifier("nobody", {});
    EXPECT_EQ(fetch.result, nullptr);
    ASSERT_TRUE(fetch.error.has_value());
    EXPECT_FALSE(fetch.error->empty());
}

TEST_P(ContactStoreContract, TheSameContact_IsTheSameObjectEachTime) {
    EXPECT_EQ(store->unifiedContactWithIdentifier("ann", {}).result,
              store->unifiedContactsMatchingEmailAddress("marsh@mail.example", {}).result.front());
}

INSTANTIATE_TEST_SUITE_P(FakeContacts, ContactStoreContract,
                         ::testing::Values(ContactStoreCase{"FakeContacts",
                                                            [](const platform::ContactStore::Contacts& contacts) {
                                                                auto made = std::make_shared<FakeContacts>();
                                                                made->contacts = contacts;
                                                                return made;
                                                            }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
