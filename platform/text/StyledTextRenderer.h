#pragma once

#include <memory>
#include <vector>

#include "platform/base/Geometry.h"
#include "platform/text/TextImage.h"
#include "platform/ui/AttributedString.h"

namespace ktr::platform {

/// How a styled text is set in its picture. Points.
struct StyledTextOptions {
    LineBreakMode lineBreakMode = LineBreakMode::WordWrapping;
    /// Left free at either end of a line.
    double lineFragmentPadding = 5.0;
    /// 0 is no limit.
    int maximumLines = 0;
    /// 0 never hyphenates.
    double hyphenationFactor = 0.0;
    /// Rectangles, in the picture's coordinates, that no line may touch.
    std::vector<Rect> exclusionPaths;
    bool rightToLeft = false;
    /// Device pixels a point: what the picture is rastered at, and its height rounded up to.
    double scale = 1.0;

    bool operator==(const StyledTextOptions&) const = default;
};

/// Makes pictures of styled texts. It holds the text engine and nothing else of the platform, so that background work
/// may outlive that. Any thread.
class KTR_API StyledTextRenderer {
  public:
    /// With the installed platform's text engine; none without one.
    static std::shared_ptr<StyledTextRenderer> make();
    explicit StyledTextRenderer(std::shared_ptr<TextEngine> engine) : engine_(std::move(engine)) {}

    /// As wide as asked, and down to the lower edge of the text's used rectangle, rounded up to a pixel. None for an
    /// empty text and for a width that is not greater than 0 or has no end.
    std::shared_ptr<TextImage> image(const AttributedString& text, double width,
                                     const StyledTextOptions& options) const;

  private:
    std::shared_ptr<TextEngine> engine_;
};

}  // namespace ktr::platform
