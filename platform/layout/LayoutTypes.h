#pragma once

#include <optional>

namespace ktr::platform {

enum class LayoutAttribute : unsigned char {
    None,
    Left,
    Right,
    Top,
    Bottom,
    Leading,
    Trailing,
    Width,
    Height,
    CenterX,
    CenterY,
    FirstBaseline,
    LastBaseline
};

enum class LayoutRelation : unsigned char { LessOrEqual, Equal, GreaterOrEqual };

enum class LayoutAxis { Horizontal, Vertical };

/// Points; none in a dimension in which the content has no size of its own.
struct IntrinsicSize {
    std::optional<double> width;
    std::optional<double> height;
    bool operator==(const IntrinsicSize&) const = default;
};

/// Points: from the top to the first baseline, from the last baseline to the bottom.
struct BaselineOffsets {
    double firstFromTop = 0.0;
    double lastFromBottom = 0.0;
    bool operator==(const BaselineOffsets&) const = default;
};

/// Priorities from 1 to 1000 are strict levels; 1000 is required.
inline constexpr double kRequiredPriority = 1000.0;
inline constexpr double kDefaultHuggingPriority = 250.0;
inline constexpr double kDefaultCompressionResistancePriority = 750.0;

struct ContentPriorities {
    double horizontalHugging = kDefaultHuggingPriority;
    double verticalHugging = kDefaultHuggingPriority;
    double horizontalCompressionResistance = kDefaultCompressionResistancePriority;
    double verticalCompressionResistance = kDefaultCompressionResistancePriority;
    bool operator==(const ContentPriorities&) const = default;
};

/// The target of a compressed fitting: as small as the constraints allow.
inline constexpr double kCompressedFittingExtent = 0.0;

}  // namespace ktr::platform
