#include "linux/paint/Initials.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

namespace {

Initials of(const std::string& given, const std::string& family) {
    platform::Contact contact;
    contact.givenName = given;
    contact.familyName = family;
    return Initials(contact);
}
std::string letters(const std::string& given, const std::string& family) {
    return of(given, family).letters().toStdString();
}
std::string lettersOfFullName(const std::string& name) {
    platform::Contact contact;
    contact.storedFullName = name;
    return Initials(contact).letters().toStdString();
}

}  // namespace

TEST(InitialsTest, TwoNames_HaveTwoCapitals) {
    EXPECT_EQ(letters("Ann", "Marsh"), "AM");
    EXPECT_EQ(letters("élise", "dubois"), "ÉD");
    EXPECT_EQ(letters("Юлия", "Котова"), "ЮК");
    EXPECT_EQ(letters("Θάλεια", "Μαρκ"), "ΘΜ");
    EXPECT_EQ(letters("נועם", "ברק"), "נב");
}

TEST(InitialsTest, OneName_HasOneLetter) {
    EXPECT_EQ(letters("Paula", ""), "P");
    EXPECT_EQ(letters("", "Marsh"), "M");
}

TEST(InitialsTest, JoiningAndStackingScripts_HaveOneLetter) {
    EXPECT_EQ(letters("ليلى", "حداد"), "ل");
    EXPECT_EQ(letters("अनन्या", "शर्मा"), "अ");
    EXPECT_EQ(letters("สมชาย", "ใจดี"), "ส");
}

TEST(InitialsTest, HanKanaAndHangul_HaveTheFamilyNamesFirst) {
    EXPECT_EQ(letters("美咲", "佐藤"), "佐");
    EXPECT_EQ(letters("민준", "김"), "김");
    EXPECT_EQ(letters("さくら", ""), "さ");
    EXPECT_EQ(lettersOfFullName("佐藤 美咲"), "佐");
}

TEST(InitialsTest, MixedScripts_DoNotMixLetters) {
    EXPECT_EQ(letters("Ann", "佐藤"), "A");
    EXPECT_EQ(letters("Ann", "حداد"), "A");
}

TEST(InitialsTest, AWholeGraphemeStands) {
    EXPECT_EQ(letters("E\xCC\x81lise", ""), "E\xCC\x81");
    EXPECT_EQ(letters("कि", ""), "कि");
}

TEST(InitialsTest, MarksAndEmojiBeforeTheLetter_ArePassedOver) {
    EXPECT_EQ(letters("“Ann”", "(Marsh)"), "AM");
    EXPECT_EQ(letters("👩‍👩‍👧‍👦 Family", ""), "F");
    EXPECT_EQ(letters("\xE2\x80\xAE"
                      "ann",
                      ""),
              "A");
    EXPECT_EQ(letters("1️⃣ One", ""), "O");
    EXPECT_EQ(letters("4 Seasons", ""), "4");
}

TEST(InitialsTest, LettersWithoutASingleCapital_StandAsTheyAre) {
    EXPECT_EQ(letters("ßen", ""), "ß");
    EXPECT_EQ(letters("ქეთი", "მამა"), "ქმ");
}

TEST(InitialsTest, FullName_GivesFirstAndLastWord) {
    EXPECT_EQ(lettersOfFullName("Ann van der Marsh"), "AM");
    EXPECT_EQ(lettersOfFullName("  Ann "), "A");
}

TEST(InitialsTest, OtherNames_ServeWhenThereIsNoneOfAPerson) {
    platform::Contact contact;
    contact.organizationName = "Fish Market";
    EXPECT_EQ(Initials(contact).letters().toStdString(), "F");
    contact.nickname = "Nan";
    EXPECT_EQ(Initials(contact).letters().toStdString(), "N");
}

TEST(InitialsTest, NamesWithoutLetters_HaveNone) {
    EXPECT_EQ(letters("👍", "!"), "");
    EXPECT_EQ(letters("\xFF\xFE", ""), "");
    EXPECT_EQ(letters("", ""), "");
}

TEST(InitialsTest, Baseline_IsTheScripts) {
    EXPECT_EQ(of("Ann", "").baseline(), 0.357);
    EXPECT_EQ(of("נועם", "").baseline(), 0.30);
    EXPECT_EQ(of("ليلى", "").baseline(), 0.26);
    EXPECT_EQ(of("", "佐藤").baseline(), 0.375);
    EXPECT_EQ(of("", "김").baseline(), 0.375);
}

}  // namespace ktr::linux_
