#include "linux/contacts/PhoneText.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

TEST(PhoneTextTest, Extensions_AreCutOff) {
    EXPECT_EQ(PhoneText::withoutExtension("01632 960003 ext. 12"), "01632 960003 ");
    EXPECT_EQ(PhoneText::withoutExtension("01632 960003 extension no. 12."), "01632 960003 ");
    EXPECT_EQ(PhoneText::withoutExtension("01632 960003 (доб. 12)"), "01632 960003 (");
    EXPECT_EQ(PhoneText::withoutExtension("01632 960003x12"), "01632 960003");
    EXPECT_EQ(PhoneText::withoutExtension("01632 960003#12"), "01632 960003");
    EXPECT_EQ(PhoneText::withoutExtension("01632960003;ext=12;other"), "01632960003");
    EXPECT_EQ(PhoneText::withoutExtension("٠١٦٣٢ ٩٦٠٠٠٢ تحويلة ١٢"), "٠١٦٣٢ ٩٦٠٠٠٢ ");
}

TEST(PhoneTextTest, WhatIsPartOfTheNumber_Stays) {
    for (const char* text : {"", " ", "12", "+44 (0)1632 960001", "1-800-EXAMPLE", "(800) FIX-BIKE", "1-800-FIX-2453",
                             "Desk 12", "ext. 12", "*7#12", "01632 960003 ext. 12345678", "01632 960003 home"}) {
        EXPECT_EQ(PhoneText::withoutExtension(text), text);
    }
    const std::string endless = "01632 960003 ext. " + std::string(100'000, '1');
    EXPECT_EQ(PhoneText::withoutExtension(endless), endless);
}

TEST(PhoneTextTest, Digits_AreOfEveryScriptAndTheKeypads) {
    EXPECT_EQ(PhoneText::digits("+٤٤ 1632-9600 (x)"), "44163296009");
    EXPECT_EQ(PhoneText::digits("1-800-Example"), "18003926753");
    EXPECT_EQ(PhoneText::digits("\xff\xfe"), "");
}

TEST(PhoneTextTest, Scheme_IsTakenOff) {
    EXPECT_EQ(PhoneText::withoutScheme("TEL:+44"), "+44");
    EXPECT_EQ(PhoneText::withoutScheme("telephone"), "telephone");
    EXPECT_EQ(PhoneText::withoutScheme(""), "");
}

}  // namespace ktr::linux_
