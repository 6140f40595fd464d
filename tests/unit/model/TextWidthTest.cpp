#include "model/TextWidth.h"

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

class TextWidthTest : public PlatformTest {
  protected:
    static constexpr platform::Font kTenPoints{platform::FontFace::Text, platform::FontWeight::Regular, 10.0};
};

TEST_F(TextWidthTest, ATextThatFitsIsMeasuredOnce) {
    EXPECT_EQ(stringConstrainedToWidth("abcde", 50.0, kTenPoints), "abcde");
    EXPECT_EQ(textEngine->count(), 1);
}

TEST_F(TextWidthTest, AWiderTextComesBackUnchanged_IsKept) {
    EXPECT_EQ(stringConstrainedToWidth("abcdefghij", 60.0, kTenPoints), "abcdefghij");
    // Ten glyphs, then nine, eight, seven, six.
    EXPECT_EQ(textEngine->count(), 5);
}

TEST_F(TextWidthTest, ShorteningEndsWithLessThanFourCharacters) {
    EXPECT_EQ(stringConstrainedToWidth("äöü日本語", 1.0, kTenPoints), "äöü日本語");
    // Six characters, five, four, and three, which is short enough.
    EXPECT_EQ(textEngine->count(), 4);
    EXPECT_EQ(stringConstrainedToWidth("", -1.0, kTenPoints), "");
    EXPECT_EQ(stringConstrainedToWidth("\xFF\x80\x80\x80\x80", 1.0, kTenPoints), "\xFF\x80\x80\x80\x80");
}

}  // namespace
}  // namespace ktr::test
