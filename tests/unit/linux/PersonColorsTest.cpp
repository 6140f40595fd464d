#include "linux/paint/PersonColors.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

TEST(PersonColorsTest, Handles_HaveTheirColours) {
    struct Case {
        const char* handle;
        std::uint32_t hash;
        std::size_t number;
    };
    for (const Case& c : {Case{"ann@harbour.example", 0x1fab71bf, 8}, Case{"l.haddad@mail.example", 0xf69a0158, 10},
                          Case{"n.barak@harbour.example", 0x40938df9, 6}, Case{"m.sato@quay.example", 0x83b89c71, 1},
                          Case{"mara.lind@harbour.example", 0xfced16be, 11}, Case{"+441632960018", 0xe4d5b3a6, 7}}) {
        EXPECT_EQ(PersonColors::hash(c.handle), c.hash) << c.handle;
        EXPECT_EQ(PersonColors::number(c.handle), c.number) << c.handle;
    }
    EXPECT_EQ(PersonColors::color(8), QColor(0x4A, 0x75, 0xB4));
    EXPECT_EQ(PersonColors::color(0), QColor(0xB1, 0x59, 0x66));
    EXPECT_EQ(PersonColors::color(11), QColor(0xAD, 0x57, 0x86));
    EXPECT_EQ(PersonColors::hash(""), 0x811c9dc5U);
}

TEST(PersonColorsTest, HandleOf_PrefersTheFirstAddressThenTheFirstNumber) {
    platform::Contact contact;
    contact.identifier = "id-7";
    EXPECT_EQ(PersonColors::handleOf(contact), "id-7");
    contact.phoneNumbers = {{"", "+44 (1632) 960-018"}, {"", "5"}};
    EXPECT_EQ(PersonColors::handleOf(contact), "+441632960018");
    contact.emailAddresses = {{"", "Ann@Harbour.Example"}, {"", "b@c"}};
    EXPECT_EQ(PersonColors::handleOf(contact), "ann@harbour.example");
}

TEST(PersonColorsTest, HandleOf_ReadsDigitsOfEveryScript) {
    platform::Contact contact;
    contact.phoneNumbers = {{"", "+٤٤١٦٣٢٩٦٠٠١٨"}};
    EXPECT_EQ(PersonColors::handleOf(contact), "+441632960018");
    contact.phoneNumbers = {{"", "ext."}};
    contact.givenName = "Ann";
    EXPECT_NE(PersonColors::handleOf(contact), "");
}

}  // namespace ktr::linux_
