#include "app/window/AccessibleConversation.h"

#include <utility>

#include "app/window/AccessibleNode.h"
#include "app/window/AccessibleWidget.h"
#include "app/window/ConversationWidget.h"
#include "platform/ui/AccessibilitySubject.h"

namespace ktr::app {

using platform::AccessibilityNode;
using platform::View;

namespace {

QAccessibleInterface* interfaceOf(const QString& /*className*/, QObject* object) {
    auto* widget = dynamic_cast<ConversationWidget*>(object);
    return widget == nullptr ? nullptr : new AccessibleWidget(*widget, widget->accessible());
}

}  // namespace

void AccessibleConversation::install() {
    QAccessible::removeFactory(interfaceOf);
    QAccessible::installFactory(interfaceOf);
}

void AccessibleConversation::changed(ConversationWidget& widget) {
    if (widget.isAccessed()) {
        widget.accessible().update();
    }
}

void AccessibleConversation::moved(ConversationWidget& widget) {
    if (!widget.isAccessed()) {
        return;
    }
    for (const auto& [view, id] : widget.accessible().interfaces_) {
        if (auto* node = QAccessible::accessibleInterface(id)) {
            QAccessibleEvent event(node, QAccessible::LocationChanged);
            QAccessible::updateAccessibility(&event);
        }
    }
}

void AccessibleConversation::focused(ConversationWidget& widget) {
    const auto view = widget.rows().focused();
    if (!widget.isAccessed() || !view) {
        return;
    }
    if (auto* node = widget.accessible().interfaceFor(view.get())) {
        QAccessibleEvent event(node, QAccessible::Focus);
        QAccessible::updateAccessibility(&event);
    }
}

AccessibleConversation::~AccessibleConversation() {
    for (const auto& [view, id] : interfaces_) {
        QAccessible::deleteAccessibleInterface(id);
    }
}

void AccessibleConversation::rebuild() {
    entries_.clear();
    topLevel_.clear();
    const auto tree = platform::accessibilityTree(widget_.host().window(), widget_.host().rightToLeft());
    for (const AccessibilityNode& node : tree.children) {
        add(node, nullptr);
    }
    built_ = true;
}

void AccessibleConversation::add(const AccessibilityNode& node, const View* parent) {
    const auto view = node.view.lock();
    if (!view) {
        return;
    }
    Entry entry;
    entry.view = view;
    entry.parent = parent;
    entry.node = node;
    entry.node.children.clear();
    entry.node.text.clear();
    entries_[view.get()] = std::move(entry);
    (parent == nullptr ? topLevel_ : entries_[parent].children).push_back(view.get());
    for (const AccessibilityNode& child : node.children) {
        add(child, view.get());
    }
}

void AccessibleConversation::update() {
    if (!built_) {
        return;
    }
    const auto before = std::exchange(entries_, {});
    const auto topBefore = topLevel_;
    rebuild();
    bool reordered = topBefore != topLevel_;
    for (auto it = interfaces_.begin(); it != interfaces_.end();) {
        const Entry* now = find(it->first);
        const auto old = before.find(it->first);
        // Another view may stand where a dropped one stood: then it is another node.
        const bool same = now != nullptr && old != before.end() && old->second.view.lock() == now->view.lock();
        auto* node = QAccessible::accessibleInterface(it->second);
        if (!same || node == nullptr) {
            changes_.forget(it->first);
            QAccessible::deleteAccessibleInterface(it->second);
            it = interfaces_.erase(it);
            reordered = true;
            continue;
        }
        if (isNews(*now->view.lock())) {
            QAccessibleEvent event(node, QAccessible::NameChanged);
            QAccessible::updateAccessibility(&event);
        }
        reordered = reordered || old->second.children != now->children;
        ++it;
    }
    if (reordered) {
        QAccessibleEvent event(&widget_, QAccessible::ObjectReorder);
        QAccessible::updateAccessibility(&event);
    }
}

bool AccessibleConversation::isNews(const View& view) {
    const auto* about = dynamic_cast<const platform::AccessibilitySubjectView*>(&view);
    return changes_.isNews(&view, nameOf(&view), about != nullptr ? about->accessibilitySubject() : std::nullopt,
                           static_cast<double>(clock_.nsecsElapsed()) * 1e-9);
}

std::string AccessibleConversation::nameOf(const View* view) {
    const Entry* entry = find(view);
    const auto there = entry == nullptr ? nullptr : entry->view.lock();
    return there ? platform::accessibilityName(there, widget_.host().rightToLeft()) : "";
}

const AccessibleConversation::Entry* AccessibleConversation::find(const View* view) {
    if (!built_) {
        rebuild();
    }
    const auto found = entries_.find(view);
    return found == entries_.end() ? nullptr : &found->second;
}

const std::vector<const View*>& AccessibleConversation::topLevel() {
    if (!built_) {
        rebuild();
    }
    return topLevel_;
}

QAccessibleInterface* AccessibleConversation::interfaceFor(const View* view) {
    if (find(view) == nullptr) {
        return nullptr;
    }
    const auto found = interfaces_.find(view);
    if (found != interfaces_.end()) {
        return QAccessible::accessibleInterface(found->second);
    }
    auto* node = new AccessibleNode(*this, view);
    interfaces_[view] = QAccessible::registerAccessibleInterface(node);
    isNews(*view);
    return node;
}

}  // namespace ktr::app
