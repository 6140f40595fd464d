#include "platform/text/StyledTextRenderer.h"

#include <algorithm>
#include <cmath>

#include "platform/base/Platform.h"

namespace ktr::platform {

namespace {

/// A height that is a whole number of pixels but for its last bits must not grow by one.
constexpr double kRoundingSlack = 1e-6;

double roundedUp(double points, double scale) {
    return scale > 0.0 ? std::ceil(points * scale - kRoundingSlack) / scale : points;
}

/// The lower edge of the used rectangle: it may begin below an exclusion that is too wide for the first word.
double lowerEdge(const TextLayout& layout) {
    double edge = 0.0;
    for (const TextLayout::Line& line : layout.lines()) {
        edge = std::max(edge, line.box.maxY());
    }
    return edge;
}

}  // namespace

std::shared_ptr<StyledTextRenderer> StyledTextRenderer::make() {
    const auto installed = Platform::installed();
    return installed && installed->textEngine ? std::make_shared<StyledTextRenderer>(installed->textEngine) : nullptr;
}

std::shared_ptr<TextImage> StyledTextRenderer::image(const AttributedString& text, double width,
                                                     const StyledTextOptions& options) const {
    if (!(width > 0.0) || !std::isfinite(width) || text.empty()) {
        return nullptr;
    }
    TextContainer container;
    container.width = width;
    container.exclusionPaths = options.exclusionPaths;
    container.lineFragmentPadding = options.lineFragmentPadding;
    container.hyphenationFactor = options.hyphenationFactor;
    container.maximumLines = options.maximumLines;
    container.lineBreakMode = options.lineBreakMode;
    container.rightToLeft = options.rightToLeft;
    auto layout = engine_->layOut(text, container);
    const Size size = {width, roundedUp(lowerEdge(*layout), options.scale)};
    return engine_->image(std::move(layout), size, options.scale);
}

}  // namespace ktr::platform
