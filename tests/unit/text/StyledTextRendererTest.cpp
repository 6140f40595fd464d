#include "platform/text/StyledTextRenderer.h"

#include <cmath>
#include <limits>

#include "tests/support/PlatformTest.h"

namespace ktr::platform {

class StyledTextRendererTest : public test::PlatformTest {
  protected:
    static constexpr double kSize = 20.0;  // points: every glyph is as wide
    AttributedString text(const std::string& words) const { return {words, Font{.size = kSize}}; }
    StyledTextRenderer renderer_{textEngine};
};

TEST_F(StyledTextRendererTest, Image_IsAsWideAsAskedAndAsHighAsItsText) {
    const auto image = renderer_.image(text("Ann Marsh"), 170.0, {});
    ASSERT_NE(image, nullptr);
    EXPECT_EQ(image->layout().lines().size(), 2u) << "nine glyphs and the padding do not fit";
    EXPECT_EQ(image->size(), (Size{170.0, 2.0 * Font{.size = kSize}.lineHeight()}));
    EXPECT_EQ(image->layout().lines()[0].box.x, 5.0) << "the padding";
}

TEST_F(StyledTextRendererTest, Height_IsRoundedUpToAPixel) {
    AttributedString words = text("Ann");
    StyledTextOptions options;
    options.exclusionPaths = {{0.0, 0.0, 170.0, 10.3}};
    EXPECT_DOUBLE_EQ(renderer_.image(words, 170.0, options)->size().height, 28.0 + 11.0);
    options.scale = 2.0;
    EXPECT_DOUBLE_EQ(renderer_.image(words, 170.0, options)->size().height, 28.0 + 10.5);
    options.exclusionPaths[0].height = 10.5;
    EXPECT_DOUBLE_EQ(renderer_.image(words, 170.0, options)->size().height, 28.0 + 10.5) << "whole already";
}

TEST_F(StyledTextRendererTest, TextThatBeginsBelowAnExclusion_IsWhole) {
    StyledTextOptions options;
    options.exclusionPaths = {{0.0, 0.0, 120.0, 54.0}};
    const auto image = renderer_.image(text("Bartho"), 170.0, options);
    EXPECT_EQ(image->layout().lines().front().box.y, 54.0);
    EXPECT_EQ(image->size().height, 54.0 + 28.0);
}

TEST_F(StyledTextRendererTest, Options_ReachTheEngine) {
    StyledTextOptions options;
    options.maximumLines = 1;
    options.lineBreakMode = LineBreakMode::TruncatingTail;
    EXPECT_TRUE(renderer_.image(text("Ann Marsh"), 100.0, options)->layout().isTruncated());
    options = {};
    options.rightToLeft = true;
    EXPECT_EQ(renderer_.image(text("Ann"), 170.0, options)->layout().lines()[0].box.maxX(), 165.0);
    options = {};
    options.hyphenationFactor = 1.0;
    const auto hyphenated = renderer_.image(text("aaaa\u00ADbbbb"), 115.0, options);
    EXPECT_EQ(hyphenated->layout().lines()[0].box.width, 5.0 * kSize);
    options.hyphenationFactor = 0.0;
    EXPECT_EQ(renderer_.image(text("aaa\u00ADbbbb"), 115.0, options)->layout().lines()[0].box.width, 5.0 * kSize);
}

TEST_F(StyledTextRendererTest, NothingToRender_IsNone) {
    EXPECT_EQ(renderer_.image(AttributedString(), 100.0, {}), nullptr);
    for (const double width : {0.0, -1.0, std::nan(""), std::numeric_limits<double>::infinity()}) {
        EXPECT_EQ(renderer_.image(text("Ann"), width, {}), nullptr) << width;
    }
}

TEST_F(StyledTextRendererTest, OfThePlatform_NoneWithoutATextEngine) {
    EXPECT_NE(StyledTextRenderer::make(), nullptr);
    platform->textEngine = nullptr;
    EXPECT_EQ(StyledTextRenderer::make(), nullptr);
    Platform::install(nullptr);
    EXPECT_EQ(StyledTextRenderer::make(), nullptr);
    Platform::install(platform);
}

}  // namespace ktr::platform
