#pragma once

#include "platform/base/Api.h"

namespace ktr::platform {

enum class FontFace { Text, Light, Thin, Rounded };
enum class FontWeight { Regular, Semibold, Bold };

/// A face, a weight and a size in points.
struct KTR_API Font {
    FontFace face = FontFace::Text;
    FontWeight weight = FontWeight::Regular;
    double size = 16.0;

    /// The height of a line's box in points: the size times 1.362 (ascent and descent of Noto Sans) rounded up. It is
    /// the same for every script, so that the rows of a list are equally high.
    double lineHeight() const;
    /// From the top of the line's box to the baseline: the size times 1.069, rounded to a whole point.
    double ascent() const;

    bool operator==(const Font&) const = default;
};

enum class TextStyle { Headline, Body, Subheadline, Footnote };

enum class ContentSizeCategory { XS, S, M, L, XL, XXL, XXXL, AX1, AX2, AX3, AX4, AX5 };

/// AX1 and larger.
KTR_API bool isAccessibilityCategory(ContentSizeCategory category);

/// The font of a text style at a category. Headline is bold, the others regular.
KTR_API Font preferredFont(TextStyle style, ContentSizeCategory category);
/// At the installed device's category (L without one). Main thread.
KTR_API Font preferredFont(TextStyle style);

}  // namespace ktr::platform
