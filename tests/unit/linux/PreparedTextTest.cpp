#include "linux/paint/PreparedText.h"

#include <gtest/gtest.h>

namespace ktr::linux_ {

using platform::AttributedString;
using platform::Font;

namespace {

QString prepared(const std::string& text) {
    return PreparedText(AttributedString(text, Font()), {}).text;
}

}  // namespace

TEST(PreparedTextTest, LineEndsOfEveryKind_AreOne) {
    const QChar end(QChar::LineSeparator);
    EXPECT_EQ(prepared("a\nb\r\nc\rd"), QStringLiteral("a") + end + u'b' + end + u'c' + end + u'd');
    EXPECT_EQ(prepared("a\xE2\x80\xA9"
                       "b"),
              QStringLiteral("a") + end + u'b');
}

TEST(PreparedTextTest, JapanesePhrases_AreHeldTogether) {
    EXPECT_EQ(prepared("を探しています"), QStringLiteral("を探\u2060し\u2060て\u2060い\u2060ま\u2060す"));
}

TEST(PreparedTextTest, JapanesePhrasesOnASingleLine_NeedNoHolding) {
    platform::TextContainer container;
    container.maximumLines = 1;
    const AttributedString text("を探しています", Font());
    EXPECT_EQ(PreparedText(text, PreparedText::Options::of(container)).text, QStringLiteral("を探しています"));
    container.maximumLines = 2;
    EXPECT_TRUE(PreparedText(text, PreparedText::Options::of(container)).text.contains(QChar(0x2060)));
}

TEST(PreparedTextTest, LineEndsAtTheEnd_AreDropped) {
    EXPECT_EQ(prepared("a\n\n"), QStringLiteral("a"));
    EXPECT_TRUE(PreparedText(AttributedString("\n", Font()), {}).runs.empty());
}

TEST(PreparedTextTest, LineEndsAtTheEndOfAnUnlimitedText_AreKept) {
    const QChar end(QChar::LineSeparator);
    EXPECT_EQ(PreparedText(AttributedString("a\n\n", Font()), {true, true}).text, QStringLiteral("a") + end + end);
}

TEST(PreparedTextTest, SoftHyphens_AreLeftOutWithoutHyphenation) {
    EXPECT_EQ(prepared("a\u00ADb"), QStringLiteral("a\u00ADb"));
    EXPECT_EQ(PreparedText(AttributedString("a\u00ADb", Font()), {false, false}).text, QStringLiteral("ab"));
}

TEST(PreparedTextTest, RunsOfAGivenDirection_AreIsolatesWhereTheyHaveWords) {
    AttributedString text;
    const platform::ParagraphStyle style = {platform::TextAlignment::Left, platform::LineBreakMode::WordWrapping,
                                            platform::WritingDirection::LeftToRight};
    text.append({"a", Font(), std::nullopt, style});
    text.append({"\n", Font(), std::nullopt, style});
    text.append({" b", Font(), std::nullopt, style});
    EXPECT_EQ(PreparedText(text, {}).text, QStringLiteral("\u2068a\u2069\u2028\u2068 b\u2069"));
}

TEST(PreparedTextTest, Controls_AreShownAsReplacements) {
    EXPECT_EQ(prepared(std::string("a\0b\x1b", 4)), QStringLiteral("a\uFFFDb\uFFFD"));
    EXPECT_EQ(prepared("a\tb"), QStringLiteral("a b"));
    EXPECT_EQ(prepared("\xEF\xBF\xBC"), QStringLiteral("\uFFFD"));
    EXPECT_EQ(prepared("a\xC0\x80"), QStringLiteral("a\uFFFD\uFFFD"));
}

TEST(PreparedTextTest, OpenDirectionalControls_AreClosedAtTheRunsEnd) {
    EXPECT_EQ(prepared("\xE2\x80\xAE"
                       "abc"),
              QStringLiteral("\u202Eabc\u202C"));
    EXPECT_EQ(prepared("\xE2\x81\xA7\xE2\x80\xAA"
                       "abc"),
              QStringLiteral("\u2067\u202Aabc\u202C\u2069"));
    EXPECT_EQ(prepared("\xE2\x81\xA7"
                       "a\xE2\x81\xA9"
                       "bc"),
              QStringLiteral("\u2067a\u2069bc"));
    EXPECT_EQ(prepared("a\xE2\x80\xAC"), QStringLiteral("a\u202C"));
}

TEST(PreparedTextTest, Direction_IsTheFirstStrongCharactersOutsideIsolates) {
    const auto rightToLeft = [](const std::string& text, bool otherwise) {
        const PreparedText prepared(AttributedString(text, Font()), {});
        return prepared.isRightToLeft(0, prepared.text.size(), otherwise);
    };
    EXPECT_FALSE(rightToLeft("12 Ann ليلى", true));
    EXPECT_TRUE(rightToLeft("(ليلى) Ann", false));
    EXPECT_TRUE(
        rightToLeft("\xE2\x81\xA6"
                    "Ann\xE2\x81\xA9 ליל",
                    false));
    EXPECT_TRUE(rightToLeft("12", true));
    EXPECT_FALSE(rightToLeft("12", false));
}

TEST(PreparedTextTest, RunAt_FindsTheRun) {
    AttributedString text;
    text.append({"ab", Font{.size = 10}, std::nullopt, {}});
    text.append({"cd", Font{.size = 20}, std::nullopt, {}});
    const PreparedText prepared(text, {});
    EXPECT_EQ(prepared.runAt(0).font.size, 10);
    EXPECT_EQ(prepared.runAt(1).font.size, 10);
    EXPECT_EQ(prepared.runAt(2).font.size, 20);
    EXPECT_EQ(prepared.runAt(4).font.size, 20);
}

}  // namespace ktr::linux_
