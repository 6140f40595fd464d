#include "platform/base/Url.h"

#include <gtest/gtest.h>

namespace ktr::test {
namespace {

TEST(UrlTest, HoldsItsTextVerbatim) {
    const auto url = platform::Url::fromText("wayloc://friend/a@b.example?%zz");
    ASSERT_TRUE(url);
    EXPECT_EQ(url->text(), "wayloc://friend/a@b.example?%zz");
}

TEST(UrlTest, BlanksAndControlCharactersMakeNoUrl) {
    for (const char* text : {"", "a b", "a\nb", "a\x7F", "\t"}) {
        EXPECT_FALSE(platform::Url::fromText(text)) << testing::PrintToString(text);
    }
}

}  // namespace
}  // namespace ktr::test
