#pragma once

#include <cstddef>
#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "platform/base/Api.h"
#include "platform/layout/LayoutConstraint.h"

namespace ktr::platform {

class View;

/// Edges, centres and baselines on which consecutive views of a format are aligned with each other; they combine with
/// `|`. A horizontal format aligns vertically (top, bottom, centerY, baselines), a vertical one horizontally.
enum class VisualFormatAlignment : unsigned {
    None = 0,
    Leading = 1U << 0,
    Trailing = 1U << 1,
    Left = 1U << 2,
    Right = 1U << 3,
    Top = 1U << 4,
    Bottom = 1U << 5,
    CenterX = 1U << 6,
    CenterY = 1U << 7,
    FirstBaseline = 1U << 8,
    LastBaseline = 1U << 9
};

constexpr VisualFormatAlignment operator|(VisualFormatAlignment a, VisualFormatAlignment b) {
    return static_cast<VisualFormatAlignment>(static_cast<unsigned>(a) | static_cast<unsigned>(b));
}

/// Where a horizontal format begins. LeadingToTrailing follows the interface's direction.
enum class VisualFormatDirection { LeadingToTrailing, LeftToRight, RightToLeft };

struct VisualFormatOptions {
    VisualFormatAlignment alignment = VisualFormatAlignment::None;
    VisualFormatDirection direction = VisualFormatDirection::LeadingToTrailing;
};

/// Points, or priorities.
using VisualFormatMetrics = std::map<std::string, double, std::less<>>;
using VisualFormatViews = std::map<std::string, std::shared_ptr<View>, std::less<>>;

/// Why a format gives no constraints, and where.
struct VisualFormatError {
    /// Bytes before the place.
    std::size_t offset = 0;
    /// Characters before the place, plus 1.
    std::size_t column = 1;
    /// What was expected there, or what is wrong with what stands there.
    std::string expected;

    /// "column 5: expected ..."
    KTR_API std::string message() const;
};

/// Constraints, not yet active, or an error.
struct VisualFormatResult {
    std::vector<std::shared_ptr<LayoutConstraint>> constraints;
    std::optional<VisualFormatError> error;
};

/// Constraints written as a picture: "H:|-margin-[name]-(>=8@750)-[distance(54)]-|". docs/layout.md has the grammar.
/// Nothing throws. Main thread.
class KTR_API VisualFormat {
  public:
    /// The space that a bare "-" stands for, in points.
    static constexpr double kSpaceBetweenViews = 8.0;
    static constexpr double kSpaceToSuperview = 20.0;

    /// In the order of the text: each gap, then the view's own sizes; then the alignments.
    static VisualFormatResult parse(std::string_view format, VisualFormatOptions options,
                                    const VisualFormatMetrics& metrics, const VisualFormatViews& views);
    /// The same for formats that are part of a program: an error is an error-level log line, and gives none.
    static std::vector<std::shared_ptr<LayoutConstraint>> constraintsWithVisualFormat(
        std::string_view format, VisualFormatOptions options, const VisualFormatMetrics& metrics,
        const VisualFormatViews& views);

    struct Picture {
        std::string_view format;
        VisualFormatOptions options;
    };
    /// The same for several formats whose constraints `view` is to hold, in this order: at once, and at less cost.
    static void addConstraints(View& view, std::span<const Picture> pictures, const VisualFormatMetrics& metrics,
                               const VisualFormatViews& views);
};

}  // namespace ktr::platform
