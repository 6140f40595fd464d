#pragma once

#include <string>

#include "platform/ui/Accessibility.h"

namespace ktr::app {

/// The words that a description adds, in the language of what is described; %@ is what they are added to.
struct DescriptionWords {
    std::string link = "%@ (link)";
    std::string image = "%@ (image)";
};

/// What a screen reader says of a tree, as text: a line an element, in reading order. What can be opened is one line
/// with all its texts, and its role behind them: "Fish Market, Ann Marsh, Now, 310 m (link)". Line ends and other
/// control characters within a text become blanks.
std::string describe(const platform::AccessibilityNode& root, const DescriptionWords& words = {});

}  // namespace ktr::app
