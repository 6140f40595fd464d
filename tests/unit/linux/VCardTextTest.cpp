#include "linux/contacts/VCardText.h"

#include <gtest/gtest.h>

#include "documents/ComputingTime.h"
#include "linux/contacts/VCardReader.h"

namespace ktr::linux_ {

namespace {

std::string repeated(const std::string& text, std::size_t times) {
    std::string all;
    for (std::size_t i = 0; i < times; ++i) {
        all += text;
    }
    return all;
}

std::string card(const std::string& lines) {
    return "BEGIN:VCARD\r\nVERSION:3.0\r\n" + lines + "END:VCARD\r\n";
}

/// Far above what reading takes, far below what comparing each with each would; of computing time.
constexpr std::chrono::seconds kLinear{5};

}  // namespace

TEST(VCardTextTest, Essential_KeepsWhatMakesAContact) {
    EXPECT_EQ(VCardText::essential(card("FN:Ann\r\nNOTE:a;b\r\n c\r\nitem1.TEL;TYPE=CELL:1\r\n 2\r\nX-OTHER:x\r\n"
                                        "item1.X-ABLabel:Boat\r\n")),
              card("FN:Ann\r\nitem1.TEL;TYPE=CELL:1\r\n 2\r\nitem1.X-ABLabel:Boat\r\n"));
}

TEST(VCardTextTest, Essential_FollowsQuotedPrintableOverItsLines) {
    const std::string lines = "FN;ENCODING=QUOTED-PRINTABLE:Ann=\r\nMarsh\r\n";
    EXPECT_EQ(VCardText::essential(card(lines)), card(lines));
}

TEST(VCardTextTest, Essential_LeavesOutWhatIsBeyondItsCaps) {
    const std::string name = "FN:Ann\r\n";
    EXPECT_EQ(VCardText::essential(card(name + "N:" + std::string(VCardText::kMostParts + 1, ';') + "\r\n")),
              card(name));
    EXPECT_EQ(VCardText::essential(card(name + "TEL:" + std::string(VCardText::kLongestProperty, '1') + "\r\n")),
              card(name));
    const std::string photo = "PHOTO:" + std::string(VCardText::kLongestProperty, 'A') + "\r\n";
    EXPECT_EQ(VCardText::essential(card(photo)), card(photo));
    const std::string many = VCardText::essential(card(repeated("TEL:1\r\n", 2 * VCardText::kMostProperties)));
    EXPECT_EQ(many, card(repeated("TEL:1\r\n", VCardText::kMostProperties - 1)));
}

// Whoever reads the text as C does would look for the two letters of a "=" behind its end.
TEST(VCardTextTest, Essential_LeavesOutWhatIsNoText) {
    const std::string whole = "BEGIN:VCARD\nFN:Ann\nEND:VCARD\n";
    std::string card = whole;
    card.insert(card.find("FN"), std::string("TEL;ENCODING=QUOTED-PRINTABLE:=\0C3\n", 35));
    EXPECT_EQ(VCardText::essential(card), whole);
}

TEST(VCardTextTest, CardsAndProblems_AreCapped) {
    const std::string cards = repeated("BEGIN:VCARD\nEND:VCARD\n", VCardText::kMostCards + 1);
    const VCardText whole = VCardText::of(cards);
    EXPECT_EQ(whole.cards.size(), VCardText::kMostCards);
    ASSERT_EQ(whole.problems.size(), 1U);
    EXPECT_EQ(whole.problems[0].line, 2 * VCardText::kMostCards + 1);
    EXPECT_EQ(VCardText::of(repeated("BEGIN:VCARD\n", 200'000)).problems.size(), VCardText::kMostProblems);
}

TEST(VCardTextTest, HostileCards_AreReadInLinearTime) {
    std::string grouped;
    for (int i = 0; i < 32'000; ++i) {
        const std::string group = "item" + std::to_string(i);
        grouped += group + ".TEL:1\r\n" + group + ".X-ABLABEL:Boat\r\n";
    }
    const std::vector<std::string> texts = {
        card("FN:Ann\r\nN:" + std::string(100'000, ';') + "\r\n"),
        card("FN:Ann\r\nTEL" + repeated(";TYPE=CELL", 100'000) + ":1\r\n"),
        card("FN:Ann\r\nTEL;TYPE=" + repeated("CELL,", 100'000) + ":1\r\n"),
        card("FN:Ann\r\nPHOTO:" + std::string(100'000, ';') + "\r\n"),
        card("FN:Ann\r\n" + grouped),
        card("FN:Ann\r\nFN" + std::string(1'000'000, ' ') + "\r\n" + repeated(" \r\n", 300'000)),
    };
    const auto before = documents::computingTime();
    for (const std::string& text : texts) {
        const auto result = VCardReader().readText(text, "people.vcf");
        ASSERT_EQ(result.contacts.size(), 1U);
        EXPECT_EQ(result.contacts[0]->storedFullName, "Ann");
    }
    EXPECT_LT(documents::computingTime() - before, kLinear);
}

}  // namespace ktr::linux_
