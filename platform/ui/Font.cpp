#include "platform/ui/Font.h"

#include <array>
#include <cmath>
#include <cstddef>

#include "platform/base/Platform.h"
#include "platform/ui/Device.h"

namespace ktr::platform {

namespace {

constexpr double kLineHeight = 1.362;
constexpr double kAscent = 1.069;
/// 16 x 1.362 must not become 23 for the last bit of a product.
constexpr double kRoundingSlack = 1e-9;

using Sizes = std::array<double, 12>;
constexpr Sizes kBody = {13, 14, 15, 16, 18, 20, 22, 27, 32, 40, 46, 52};
constexpr Sizes kSubheadline = {11, 12, 12, 13, 15, 16, 18, 22, 26, 31, 36, 41};
constexpr Sizes kFootnote = {11, 11, 11, 12, 13, 15, 16, 20, 24, 28, 32, 36};

const Sizes& sizesOf(TextStyle style) {
    switch (style) {
        case TextStyle::Subheadline:
            return kSubheadline;
        case TextStyle::Footnote:
            return kFootnote;
        case TextStyle::Headline:
        case TextStyle::Body:
            break;
    }
    return kBody;
}

}  // namespace

double Font::lineHeight() const {
    return std::ceil(size * kLineHeight - kRoundingSlack);
}
double Font::ascent() const {
    return std::round(size * kAscent);
}

bool isAccessibilityCategory(ContentSizeCategory category) {
    return category >= ContentSizeCategory::AX1;
}

Font preferredFont(TextStyle style, ContentSizeCategory category) {
    const FontWeight weight = style == TextStyle::Headline ? FontWeight::Bold : FontWeight::Regular;
    return {FontFace::Text, weight, sizesOf(style)[static_cast<std::size_t>(category)]};
}

Font preferredFont(TextStyle style) {
    const auto platform = Platform::installed();
    const auto category =
        platform && platform->device ? platform->device->contentSizeCategory() : ContentSizeCategory::L;
    return preferredFont(style, category);
}

}  // namespace ktr::platform
