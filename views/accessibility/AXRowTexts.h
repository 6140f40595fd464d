#pragma once

#include <string>
#include <vector>

#include "platform/ui/AttributedString.h"

namespace ktr {

/// The texts of an accessibility row and the look that they have together. A value: taken on the main thread, composed
/// on any.
struct AXRowTexts {
    std::string name;
    /// What follows the name's line, piece by piece; empty pieces are left out.
    std::vector<std::string> pieces;
    /// Of the name, and of the pieces.
    platform::Font headline;
    platform::Font subheadline;
    bool rightToLeft = false;

    /// At the user's text size. Main thread.
    static AXRowTexts make(std::string name, std::vector<std::string> pieces, bool rightToLeft);
    /// The name and a line break, then the pieces one after the other: wrapped at words, at the interface's leading
    /// edge and in its direction.
    platform::AttributedString composed() const;

    bool operator==(const AXRowTexts&) const = default;
};

}  // namespace ktr
