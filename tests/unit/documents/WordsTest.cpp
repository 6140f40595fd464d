#include "documents/Words.h"

#include <gtest/gtest.h>

#include "platform/base/Utf8.h"

namespace ktr::test {

using documents::forLine;
using documents::inQuotes;
using documents::withoutControls;

TEST(WordsTest, ForLine_EscapesWhatSteersATerminalOrTurnsALine) {
    EXPECT_EQ(forLine("a\nb\r\tc\x1b[31m\x7f\0", 100), "a\\nb\\r\\tc\\x1b[31m\\x7f");
    EXPECT_EQ(forLine(std::string("a\0b", 3)), "a\\x00b");
    EXPECT_EQ(forLine("\u0085\u009b2J\u2028\u2029"), "\\u0085\\u009b2J\\u2028\\u2029");
    EXPECT_EQ(forLine("\u202a\u202b\u202d\u202e\u202c\u2066\u2067\u200e\u200f\u061c"),
              "\\u202a\\u202b\\u202d\\u202e\\u202c\\u2066\\u2067\\u200e\\u200f\\u061c");
    EXPECT_EQ(forLine("a\x9b\x33\xff"), "a\uFFFD3\uFFFD");
    EXPECT_EQ(forLine("Zoë \"of\" C:\\ 東京 א"), "Zoë \"of\" C:\\ 東京 א");
}

TEST(WordsTest, ForLine_CutsBetweenCharacters) {
    EXPECT_EQ(forLine("abc", 3), "abc");
    EXPECT_EQ(forLine("ééé", 3), "éé…");
    EXPECT_LT(forLine(std::string(1'000'000, '\x1b')).size(), 5 * documents::kLongestLine);
}

TEST(WordsTest, InQuotes_EscapesQuotesAndIsolatesRightToLeft) {
    EXPECT_EQ(inQuotes("a\"b\\\n"), "\"a\\\"b\\\\\\n\"");
    EXPECT_EQ(inQuotes("אבג"), "\u2068\"אבג\"\u2069");
    EXPECT_EQ(inQuotes("\u2069\u2068"), "\"\\u2069\\u2068\"");
    EXPECT_EQ(inQuotes(std::string(100, 'a'), 10), "\"" + std::string(10, 'a') + "…\"");
    // A line that was worded with it is printed as it stands.
    EXPECT_EQ(forLine("found " + inQuotes("אבג")), "found \u2068\"אבג\"\u2069");
}

TEST(WordsTest, EveryByte_GivesOneLineOfUtf8) {
    for (int first = 0; first < 256; ++first) {
        for (int second = 0; second < 256; ++second) {
            const std::string text{static_cast<char>(first), static_cast<char>(second)};
            for (const std::string& line : {forLine(text), inQuotes(text), withoutControls(text)}) {
                ASSERT_TRUE(platform::isValidUtf8(line));
                ASSERT_EQ(line.find_first_of("\n\r\x1b\x7f"), std::string::npos);
            }
        }
    }
}

TEST(WordsTest, WithoutControls_LeavesBlanks) {
    EXPECT_EQ(withoutControls("a\nb\u009bc\u2028d\u202ee\x1b"), "a b c d e ");
    EXPECT_EQ(withoutControls("\u2068Ann\u2069 \u200f"), "\u2068Ann\u2069 \u200f");
}

TEST(WordsTest, AsShellWord_RunsNothing) {
    EXPECT_EQ(documents::asShellWord("Where is $(x) `y` \"z\"?\n"), "'Where is $(x) `y` \"z\"? '");
    EXPECT_EQ(documents::asShellWord("O'Brien"), "'O'\\''Brien'");
    EXPECT_EQ(documents::asShellWord(""), "''");
}

TEST(WordsTest, JsonForTerminal_IsTheSameValueWithoutWhatSteers) {
    EXPECT_EQ(documents::jsonForTerminal("{\"a\":\"x\u009b31m\x7f\u202e\u200f\u2068 Zoë\"}\n"),
              "{\"a\":\"x\\u009b31m\\u007f\\u202e\\u200f\\u2068 Zoë\"}\n");
}

}  // namespace ktr::test
