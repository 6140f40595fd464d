#pragma once

#include <limits>
#include <memory>
#include <vector>

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"
#include "platform/ui/AttributedString.h"

namespace ktr::platform {

class TextImage;

/// Where text is laid out. Points.
struct TextContainer {
    /// May be infinite: one line a paragraph, each beginning at the left edge whatever its alignment.
    double width = std::numeric_limits<double>::infinity();
    /// Rectangles, in the container's coordinates, that no line may touch.
    std::vector<Rect> exclusionPaths;
    /// Left free at either end of a line; part of the used size.
    double lineFragmentPadding = 0.0;
    /// 0 never hyphenates, not even at a soft hyphen. Above it a word may be hyphenated.
    double hyphenationFactor = 0.0;
    /// 0 is no limit. With a limit the last line ends in an ellipsis when the text goes on (tail truncation).
    int maximumLines = 0;
    LineBreakMode lineBreakMode = LineBreakMode::WordWrapping;
    /// For runs whose paragraph style says Natural; Natural itself is the leading edge of the interface's direction.
    TextAlignment alignment = TextAlignment::Natural;
    bool rightToLeft = false;

    bool operator==(const TextContainer&) const = default;
};

/// A text that has been shaped and broken into lines. Immutable; any thread.
class KTR_API TextLayout {
  public:
    struct Line {
        /// The line's box in the container, from its first to its last glyph, `Font::lineHeight` high or higher.
        Rect box;
        /// From the container's top.
        double baseline = 0.0;
    };

    virtual ~TextLayout();
    /// The union of the lines' boxes with their padding: width and height, points. Zero for an empty text.
    virtual Size usedSize() const = 0;
    virtual const std::vector<Line>& lines() const = 0;
    virtual bool isTruncated() const = 0;
};

/// Shapes and breaks text. Bidirectional text, any script; malformed UTF-8 is shown as U+FFFD. Any thread.
class KTR_API TextEngine {
  public:
    virtual ~TextEngine();
    /// Never none. An empty text has no lines. A line end at the very end of a text without a limit of lines is
    /// followed by an empty line, as high as the last run's font; with a limit it counts for nothing. A word that is
    /// wider than the room beside an exclusion stands below it when it fits there, and else breaks between graphemes.
    /// Line boxes are as high as `Font::lineHeight` says; of several fonts in a line the highest; a line of wrapped
    /// text may be higher when its glyphs need it. A width that falls short of what was measured by less than 0.01
    /// points still fits. A mark that begins no line of Chinese or Japanese takes the letter before it along.
    virtual std::shared_ptr<const TextLayout> layOut(const AttributedString& text, const TextContainer& container) = 0;
    /// A picture of a text that this engine laid out, of a size in points. An engine that rasters does so here, at
    /// `scale` pixels a point, so that painting the picture at that scale costs little; the base keeps the text alone.
    virtual std::shared_ptr<TextImage> image(std::shared_ptr<const TextLayout> layout, const Size& size, double scale);
};

}  // namespace ktr::platform
