#include "linux/paint/JapanesePhrases.h"

#include <gtest/gtest.h>

#include <string>

namespace ktr::linux_ {

namespace {

constexpr char16_t kJoiner = 0x2060;
constexpr char16_t kBreakMark = 0x200B;

/// With what holds together written as "=", and what may part as "|".
std::string shown(QString text) {
    return text.replace(QChar(kJoiner), QChar(u'=')).replace(QChar(kBreakMark), QChar(u'|')).toStdString();
}

QString joined(const char* text) {
    return JapanesePhrases::joined(QString::fromUtf8(text));
}

/// The joined text with the phrase around the first joiner after `at` loosened.
std::string loosened(const char* text, qsizetype at, bool expected) {
    QString all = joined(text);
    EXPECT_EQ(JapanesePhrases::loosen(all, all.indexOf(QChar(kJoiner), at)), expected) << text;
    return shown(all);
}

}  // namespace

TEST(JapanesePhrasesTest, LettersOfAPhrase_AreHeldTogether) {
    EXPECT_EQ(shown(joined("友だちをすべて表示")), "友=だ=ち=をす=べ=て表=示");
    EXPECT_EQ(shown(joined("を探しています")), "を探=し=て=い=ま=す");
    EXPECT_EQ(shown(joined("Ann、Otto")), "Ann、Otto");
    EXPECT_EQ(shown(joined("佐藤 美咲")), "佐藤 美咲") << "may be Chinese";
    EXPECT_EQ(joined(""), QString());
}

TEST(JapanesePhrasesTest, TwoKanji_AreOneWordThoughThePhrasesPartThem) {
    EXPECT_EQ(shown(joined("見守っています。")), "見=守=っ=て=い=ま=す。");
}

TEST(JapanesePhrasesTest, LastKanjiOfAWord_IsNotTakenForTheFirstOfTheNext) {
    EXPECT_EQ(shown(joined("フェリー乗り場前広場")), "フ=ェ=リ=ー乗=り=場前広=場");
}

TEST(JapanesePhrasesTest, NumberAndWhatItCounts_AreHeldTogether) {
    EXPECT_EQ(shown(joined("近くの2人です。")), "近=く=の2=人=で=す。");
    EXPECT_EQ(shown(joined("12分前")), "12=分前");
    EXPECT_EQ(shown(joined("4分钟前")), "4=分钟前");
    EXPECT_EQ(shown(joined("第2 中学")), "第2 中学");
}

TEST(JapanesePhrasesTest, TextOfAWholeBook_IsLeftAlone) {
    const QString book = QStringLiteral("友だち").repeated(1000);
    EXPECT_EQ(JapanesePhrases::joined(book), book);
}

TEST(JapanesePhrasesTest, LoosenedPhrase_PartsBetweenItsWordsAlone) {
    EXPECT_EQ(loosened("見守っています。", 0, true), "見=守=っ=て|い|ま=す。");
    EXPECT_EQ(loosened("友だちは見つかりませんでした。", 8, true), "友=だ=ち=は見|つ|か|り|ま|せ=ん|で|し=た。");
}

TEST(JapanesePhrasesTest, PhraseOfOneWord_StaysWhole) {
    EXPECT_EQ(loosened("友だち", 0, false), "友=だ=ち");
    EXPECT_EQ(loosened("コーヒー", 0, false), "コ=ー=ヒ=ー");
}

TEST(JapanesePhrasesTest, LoosenedTwice_IsTheSame) {
    QString text = joined("見守っています。");
    EXPECT_TRUE(JapanesePhrases::loosen(text, 3));
    const QString once = text;
    EXPECT_FALSE(JapanesePhrases::loosen(text, 3));
    EXPECT_EQ(text, once);
}

TEST(JapanesePhrasesTest, MarksAndSmallLetters_AreBoundToWhatIsBefore) {
    const auto bound = [](const char* text) { return JapanesePhrases::isBoundToBefore(QString::fromUtf8(text), 1); };
    for (const char* text :
         {"あ。", "あ、", "あ」", "ラー", "あっ", "あゃ", "あ！", "あ？", "あ）", "人々", "あ!", "a。"}) {
        EXPECT_TRUE(bound(text)) << text;
    }
    for (const char* text : {"あい", "あ「", "あa", "a.", "a,b", "12", "a\"", "あ", ""}) {
        EXPECT_FALSE(bound(text)) << text;
    }
    EXPECT_FALSE(JapanesePhrases::isBoundToBefore(QStringLiteral("。"), 0)) << "nothing is before it";
    EXPECT_TRUE(JapanesePhrases::isBoundToBefore(QStringLiteral("ラ\u2060ー"), 1)) << "joined";
}

}  // namespace ktr::linux_
