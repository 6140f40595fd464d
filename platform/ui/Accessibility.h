#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/base/Api.h"
#include "platform/base/Geometry.h"

namespace ktr::platform {

class View;

enum class AccessibilityRole { None, Group, Text, Image, Link };

/// A node of what a screen reader sees, in reading order.
struct KTR_API AccessibilityNode {
    AccessibilityRole role = AccessibilityRole::None;
    std::string text;
    /// In the coordinates of the root of the view tree, points.
    Rect frame;
    /// The view that the node stands for: its identity over updates, and what a press goes to. May be gone.
    std::weak_ptr<View> view;
    bool pressable = false;
    std::vector<AccessibilityNode> children;
};

/// The tree below a view: hidden views and views that are not presented are left out, as are texts with nothing to say.
/// A link and a text are one element each, saying its own text or else all that is in it, with the language's commas.
/// Reading order: from top to bottom, then from the leading to the trailing edge. Main thread.
KTR_API AccessibilityNode accessibilityTree(const std::shared_ptr<View>& root, bool rightToLeft);

/// What is said of one view now: what its node of the tree would say.
KTR_API std::string accessibilityName(const std::shared_ptr<View>& view, bool rightToLeft);

/// Presses the node's view: its tap recognisers fire. False when the view is gone or takes no taps.
KTR_API bool accessibilityPress(const AccessibilityNode& node);

}  // namespace ktr::platform
