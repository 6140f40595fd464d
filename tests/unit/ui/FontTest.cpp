#include "platform/ui/Font.h"

#include <vector>

#include "tests/support/PlatformTest.h"

namespace ktr::test {

using namespace platform;

using FontTest = PlatformTest;

TEST_F(FontTest, LineHeight_IsTheSizeTimes1362RoundedUp) {
    const std::vector<std::pair<double, double>> boxes = {{16, 22}, {13, 18}, {12, 17}, {40, 55}, {31, 43}, {28, 39}};
    for (const auto& [size, height] : boxes) {
        EXPECT_EQ((Font{FontFace::Text, FontWeight::Regular, size}.lineHeight()), height) << size;
    }
}

TEST_F(FontTest, Ascent_PutsTheAgesBaselineOnTheAvatarsLowerEdge) {
    const Font place = preferredFont(TextStyle::Subheadline, ContentSizeCategory::L);
    const Font name = preferredFont(TextStyle::Headline, ContentSizeCategory::L);
    EXPECT_EQ(10.0 + place.lineHeight() + name.lineHeight() + place.ascent(), 64.0);
}

TEST_F(FontTest, PreferredFont_HeadlineIsBold_OthersAreRegular) {
    EXPECT_EQ(preferredFont(TextStyle::Headline, ContentSizeCategory::L), (Font{FontFace::Text, FontWeight::Bold, 16}));
    EXPECT_EQ(preferredFont(TextStyle::Body, ContentSizeCategory::L), (Font{FontFace::Text, FontWeight::Regular, 16}));
    EXPECT_EQ(preferredFont(TextStyle::Subheadline, ContentSizeCategory::XS).size, 11);
    EXPECT_EQ(preferredFont(TextStyle::Footnote, ContentSizeCategory::AX5).size, 36);
    EXPECT_EQ(preferredFont(TextStyle::Headline, ContentSizeCategory::AX3).size, 40);
}

TEST_F(FontTest, PreferredFont_FollowsTheDevicesCategory) {
    device->category = ContentSizeCategory::XXXL;
    EXPECT_EQ(preferredFont(TextStyle::Headline).size, 22);
    Platform::install(nullptr);
    EXPECT_EQ(preferredFont(TextStyle::Headline).size, 16);
}

TEST_F(FontTest, AccessibilityCategories_BeginAtAX1) {
    EXPECT_FALSE(isAccessibilityCategory(ContentSizeCategory::XXXL));
    EXPECT_TRUE(isAccessibilityCategory(ContentSizeCategory::AX1));
}

}  // namespace ktr::test
