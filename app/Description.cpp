#include "app/Description.h"

#include "documents/Words.h"
#include "platform/base/Format.h"

namespace ktr::app {

using platform::AccessibilityNode;
using platform::AccessibilityRole;

namespace {

void writeLine(const std::string& line, AccessibilityRole role, const DescriptionWords& words, std::string& out) {
    const std::string shown = documents::withoutControls(line);
    out += role == AccessibilityRole::Link    ? platform::formatted(words.link, {shown})
           : role == AccessibilityRole::Image ? platform::formatted(words.image, {shown})
                                              : shown;
    out += '\n';
}

void writeNode(const AccessibilityNode& node, const DescriptionWords& words, std::string& out) {
    // A group's name only says what the group is.
    if (!node.text.empty() && node.role != AccessibilityRole::Group) {
        writeLine(node.text, node.role, words, out);
    }
    for (const AccessibilityNode& child : node.children) {
        writeNode(child, words, out);
    }
}

}  // namespace

std::string describe(const AccessibilityNode& root, const DescriptionWords& words) {
    std::string out;
    writeNode(root, words, out);
    return out;
}

}  // namespace ktr::app
