#include "app/Description.h"

#include <string_view>

namespace ktr::app {

using platform::AccessibilityNode;
using platform::AccessibilityRole;

namespace {

void collectTexts(const AccessibilityNode& node, std::string& line) {
    if (!node.text.empty()) {
        line += (line.empty() ? "" : ", ") + node.text;
    }
    for (const AccessibilityNode& child : node.children) {
        collectTexts(child, line);
    }
}

/// Blanks for what would end a line or steer a terminal: the control characters of both ranges, in UTF-8, and the line
/// and the paragraph separator.
std::string withoutControls(const std::string& text) {
    std::string out;
    for (std::size_t at = 0; at < text.size();) {
        const std::string_view rest = std::string_view(text).substr(at);
        const auto first = static_cast<unsigned char>(rest[0]);
        std::size_t length = first < 0x20 || first == 0x7F ? 1 : 0;
        if (first == 0xC2 && rest.size() > 1 && static_cast<unsigned char>(rest[1]) < 0xA0) {
            length = 2;
        } else if (rest.substr(0, 3) == "\u2028" || rest.substr(0, 3) == "\u2029") {
            length = 3;
        }
        out += length > 0 ? ' ' : text[at];
        at += length > 0 ? length : 1;
    }
    return out;
}

void writeLine(const std::string& line, AccessibilityRole role, std::string& out) {
    out += withoutControls(line);
    if (role == AccessibilityRole::Link) {
        out += " (link)";
    } else if (role == AccessibilityRole::Image) {
        out += " (image)";
    }
    out += '\n';
}

void writeNode(const AccessibilityNode& node, std::string& out) {
    if (node.role == AccessibilityRole::Link) {
        std::string line;
        collectTexts(node, line);
        writeLine(line, node.role, out);
        return;
    }
    if (!node.text.empty()) {
        writeLine(node.text, node.role, out);
    }
    for (const AccessibilityNode& child : node.children) {
        writeNode(child, out);
    }
}

}  // namespace

std::string describe(const AccessibilityNode& root) {
    std::string out;
    writeNode(root, out);
    return out;
}

}  // namespace ktr::app
