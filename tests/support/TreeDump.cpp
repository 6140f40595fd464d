#include "tests/support/TreeDump.h"

#include <array>
#include <cmath>
#include <cstdio>

#include "platform/base/Json.h"
#include "platform/ui/Label.h"

namespace ktr::test {

using namespace platform;

namespace {

/// Three digits, without trailing zeros and without a negative zero.
std::string number(double value) {
    const double rounded = std::round(value * 1000.0) / 1000.0;
    return writeJsonNumber(rounded == 0.0 ? 0.0 : rounded);
}

std::string rectText(const Rect& rect) {
    return "(" + number(rect.x) + " " + number(rect.y) + " " + number(rect.width) + " " + number(rect.height) + ")";
}

std::string className(const View& view) {
    const std::string name = view.Object::description();
    return name.substr(1, name.size() - 2);
}

void dump(const View& view, int depth, std::string& out) {
    out += std::string(static_cast<std::size_t>(depth) * 2, ' ') + className(view) + " " + rectText(view.frame());
    if (view.hidden()) {
        out += " hidden";
    }
    if (const auto* label = dynamic_cast<const Label*>(&view)) {
        out += " " + writeJsonString(label->text()) + " " + number(label->font().size);
        if (const auto layout = label->textLayout()) {
            out += layout->isTruncated() ? " truncated" : "";
            out += layout->lines().size() > 1 ? " lines=" + std::to_string(layout->lines().size()) : "";
        }
    }
    out += "\n";
    for (const auto& child : view.presentedSubviews()) {
        dump(*child, depth + 1, out);
    }
}

const char* roleName(AccessibilityRole role) {
    switch (role) {
        case AccessibilityRole::Group:
            return "group";
        case AccessibilityRole::Text:
            return "text";
        case AccessibilityRole::Image:
            return "image";
        case AccessibilityRole::Link:
            return "link";
        case AccessibilityRole::None:
            break;
    }
    return "none";
}

void dump(const AccessibilityNode& node, int depth, std::string& out) {
    out += std::string(static_cast<std::size_t>(depth) * 2, ' ') + roleName(node.role) + " " + rectText(node.frame);
    out += node.text.empty() ? "" : " " + writeJsonString(node.text);
    out += node.pressable ? " pressable\n" : "\n";
    for (const auto& child : node.children) {
        dump(child, depth + 1, out);
    }
}

}  // namespace

std::string layoutDump(const View& root) {
    std::string out;
    dump(root, 0, out);
    return out;
}

std::string accessibilityDump(const AccessibilityNode& root) {
    std::string out;
    dump(root, 0, out);
    return out;
}

}  // namespace ktr::test
