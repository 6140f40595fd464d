#include "serve/ServedContacts.h"

#include <gtest/gtest.h>

namespace ktr::serve {

namespace {

TEST(KTRServedContactsTest, Card_HasNamesAndHandles) {
    ServedFriend ann;
    ann.fullName = "Ann Marsh";
    ann.firstName = "Ann";
    ann.lastName = "Marsh";
    ann.emails = {"ann@harbour.example"};
    ann.phones = {"+44 1632 960001"};
    EXPECT_EQ(ServedContacts::vCards({ann}),
              "BEGIN:VCARD\r\nVERSION:3.0\r\nFN:Ann Marsh\r\nN:Marsh;Ann;;;\r\n"
              "EMAIL;TYPE=INTERNET:ann@harbour.example\r\nTEL;TYPE=CELL:+44 1632 960001\r\nEND:VCARD\r\n");
}

TEST(KTRServedContactsTest, Nameless_GetsNoCard) {
    ServedFriend stranger;
    stranger.phones = {"+44 1632 960018"};
    EXPECT_EQ(ServedContacts::vCards({stranger}), "");
}

TEST(KTRServedContactsTest, Text_CannotEndItsLine) {
    ServedFriend odd;
    odd.fullName = "A;B,C\\D\nTEL:1\rEMAIL:x@y.example";
    const std::string cards = ServedContacts::vCards({odd});
    EXPECT_NE(cards.find("FN:A\\;B\\,C\\\\D\\nTEL:1 EMAIL:x@y.example\r\n"), std::string::npos) << cards;
    EXPECT_EQ(cards.find("\nTEL"), std::string::npos);
}

}  // namespace

}  // namespace ktr::serve
