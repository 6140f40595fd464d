#pragma once

#include <memory>
#include <string>

#include "platform/ui/Accessibility.h"
#include "platform/ui/View.h"

namespace ktr::test {

/// The presented view tree as text, a view a line: class, frame, what it shows. Points with three digits.
std::string layoutDump(const platform::View& root);

/// The accessibility tree as text, a node a line: role, frame, what is said.
std::string accessibilityDump(const platform::AccessibilityNode& root);

}  // namespace ktr::test
