#include "platform/ui/Accessibility.h"

#include <algorithm>

#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"
#include "platform/ui/AccessibilitySubject.h"
#include "platform/ui/View.h"

namespace ktr::platform {

AccessibilitySubjectView::~AccessibilitySubjectView() = default;

namespace {

/// Whether `a` is read before `b`: a box that ends above the other's middle comes first, else the leading one.
bool readsBefore(const AccessibilityNode& a, const AccessibilityNode& b, bool rightToLeft) {
    const double middleA = a.frame.y + a.frame.height / 2.0;
    const double middleB = b.frame.y + b.frame.height / 2.0;
    if (a.frame.maxY() <= middleB || b.frame.maxY() <= middleA) {
        return middleA < middleB;
    }
    return rightToLeft ? a.frame.maxX() > b.frame.maxX() : a.frame.x < b.frame.x;
}

/// Few nodes a view and an order that need not be transitive: insertion keeps it stable and well defined.
void sortForReading(std::vector<AccessibilityNode>& nodes, bool rightToLeft) {
    for (std::size_t i = 1; i < nodes.size(); ++i) {
        for (std::size_t j = i; j > 0 && readsBefore(nodes[j], nodes[j - 1], rightToLeft); --j) {
            std::swap(nodes[j], nodes[j - 1]);
        }
    }
}

void collect(const std::shared_ptr<View>& view, Point origin, bool rightToLeft, std::vector<AccessibilityNode>& out);

std::vector<AccessibilityNode> childrenOf(const View& view, Point origin, bool rightToLeft) {
    std::vector<AccessibilityNode> children;
    for (const auto& child : view.presentedSubviews()) {
        if (!child->hidden()) {
            collect(child, {origin.x + child->frame().x, origin.y + child->frame().y}, rightToLeft, children);
        }
    }
    sortForReading(children, rightToLeft);
    return children;
}

/// What the assistant's language writes between the things of a list.
const char* comma() {
    const auto installed = Platform::installed();
    const auto code = installed && installed->assistant ? installed->assistant->languageCode() : std::nullopt;
    const std::string language = code ? code->substr(0, code->find_first_of("-_")) : "";
    if (language == "ar" || language == "fa" || language == "ur") {
        return "\u060C ";
    }
    return language == "ja" ? "\u3001" : language == "zh" ? "\uFF0C" : ", ";
}

/// All that the nodes say, in their order.
void collectTexts(const std::vector<AccessibilityNode>& nodes, std::string& line) {
    for (const AccessibilityNode& node : nodes) {
        if (!node.text.empty()) {
            line += (line.empty() ? "" : comma()) + node.text;
        }
        collectTexts(node.children, line);
    }
}

/// A listener walks from element to element: what is opened as a whole is one, and so is a text.
bool isOneElement(AccessibilityRole role) {
    return role == AccessibilityRole::Link || role == AccessibilityRole::Text;
}

void collect(const std::shared_ptr<View>& view, Point origin, bool rightToLeft, std::vector<AccessibilityNode>& out) {
    const AccessibilityRole role = view->accessibilityRole();
    std::string text = view->accessibilityText();
    std::vector<AccessibilityNode> children;
    if (!isOneElement(role) || text.empty()) {
        children = childrenOf(*view, origin, rightToLeft);
    }
    if (isOneElement(role)) {
        collectTexts(children, text);
        children.clear();
    }
    if (role == AccessibilityRole::None || (text.empty() && children.empty())) {
        std::move(children.begin(), children.end(), std::back_inserter(out));
        return;
    }
    AccessibilityNode node;
    node.role = role;
    node.text = std::move(text);
    node.frame = {origin.x, origin.y, view->frame().width, view->frame().height};
    node.view = view;
    node.pressable = role == AccessibilityRole::Link;
    node.children = std::move(children);
    out.push_back(std::move(node));
}

}  // namespace

AccessibilityNode accessibilityTree(const std::shared_ptr<View>& root, bool rightToLeft) {
    AccessibilityNode node;
    node.role = AccessibilityRole::Group;
    node.view = root;
    node.frame = root->bounds();
    node.children = childrenOf(*root, {0.0, 0.0}, rightToLeft);
    return node;
}

std::string accessibilityName(const std::shared_ptr<View>& view, bool rightToLeft) {
    std::string text = view->accessibilityText();
    if (text.empty() && isOneElement(view->accessibilityRole())) {
        collectTexts(childrenOf(*view, {0.0, 0.0}, rightToLeft), text);
    }
    return text;
}

bool accessibilityPress(const AccessibilityNode& node) {
    const auto view = node.view.lock();
    if (!view || view->gestureRecognizers().empty()) {
        return false;
    }
    const auto recognizers = view->gestureRecognizers();
    for (const auto& recognizer : recognizers) {
        recognizer->fire();
    }
    return true;
}

}  // namespace ktr::platform
