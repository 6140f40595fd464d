#include "platform/base/Utf8.h"

#include <gtest/gtest.h>

namespace ktr::test {
namespace {

using platform::asciiLowercased;
using platform::decodeUtf8;
using platform::isValidUtf8;
using platform::sanitizedUtf8;
using platform::utf8Length;

TEST(Utf8Test, DecodesEveryLength) {
    struct Case {
        const char* text;
        char32_t point;
        std::size_t length;
    };
    for (const Case& c : {Case{"A", U'A', 1}, Case{"é", U'é', 2}, Case{"€", U'€', 3}, Case{"🙂", U'🙂', 4},
                          Case{"\x7F", 0x7F, 1}}) {
        const auto step = decodeUtf8(c.text, 0);
        EXPECT_TRUE(step.valid) << c.text;
        EXPECT_EQ(step.codePoint, c.point) << c.text;
        EXPECT_EQ(step.length, c.length) << c.text;
        std::string back;
        platform::appendUtf8(back, c.point);
        EXPECT_EQ(back, c.text);
    }
}

TEST(Utf8Test, TheEndDecodesToNothing) {
    EXPECT_EQ(decodeUtf8("", 0).length, 0U);
    EXPECT_EQ(decodeUtf8("a", 5).length, 0U);
}

TEST(Utf8Test, MalformedBytesAreFoundOut) {
    for (const char* text :
         {"\x80", "\xC0\xAF", "\xC1\xBF", "\xE0\x80\x80", "\xED\xA0\x80", "\xED\xBF\xBF", "\xF0\x80\x80\x80",
          "\xF4\x90\x80\x80", "\xF5\x80\x80\x80", "\xFF", "\xC3", "\xE2\x82", "\xF0\x9F\x99", "\xC3(", "\xE2(\xA1"}) {
        EXPECT_FALSE(isValidUtf8(text)) << testing::PrintToString(text);
        const auto step = decodeUtf8(text, 0);
        EXPECT_FALSE(step.valid);
        EXPECT_EQ(step.length, 1U);
        EXPECT_EQ(step.codePoint, 0xFFFDU);
    }
    EXPECT_TRUE(isValidUtf8("Grüße, 日本, 🙂"));
    EXPECT_TRUE(isValidUtf8("\xF4\x8F\xBF\xBF"));
}

TEST(Utf8Test, SanitizingKeepsWhatIsWellFormed) {
    EXPECT_EQ(sanitizedUtf8("a\xFF"
                            "é"),
              "a\xEF\xBF\xBD"
              "é");
    EXPECT_EQ(sanitizedUtf8("日本"), "日本");
    EXPECT_TRUE(isValidUtf8(sanitizedUtf8("\xF0\x9F\xED\xA0\x80 x")));
}

TEST(Utf8Test, LengthCountsCodePoints) {
    EXPECT_EQ(utf8Length(""), 0U);
    EXPECT_EQ(utf8Length("aé€🙂"), 4U);
    EXPECT_EQ(utf8Length("\xFF\xFF"), 2U);
}

TEST(Utf8Test, LowerCasingIsAsciiAlone) {
    EXPECT_EQ(asciiLowercased("_$!<HOME>!$_ ÄÖ"), "_$!<home>!$_ ÄÖ");
}

}  // namespace
}  // namespace ktr::test
