#include "app/Description.h"

#include "documents/Words.h"

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

void writeLine(const std::string& line, AccessibilityRole role, std::string& out) {
    out += documents::withoutControls(line);
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
