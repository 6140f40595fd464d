#include "app/window/AccessibleNode.h"

#include <QWindow>

#include "app/window/ConversationWidget.h"

namespace ktr::app {

using platform::AccessibilityRole;

QWindow* AccessibleNode::window() const {
    return conversation_.widget().window()->windowHandle();
}

QAccessibleInterface* AccessibleNode::parent() const {
    const auto* self = entry();
    if (self == nullptr || self->parent == nullptr) {
        return QAccessible::queryAccessibleInterface(&conversation_.widget());
    }
    return conversation_.interfaceFor(self->parent);
}

int AccessibleNode::childCount() const {
    const auto* self = entry();
    return self == nullptr ? 0 : static_cast<int>(self->children.size());
}

QAccessibleInterface* AccessibleNode::child(int index) const {
    const auto* self = entry();
    if (self == nullptr || index < 0 || index >= childCount()) {
        return nullptr;
    }
    return conversation_.interfaceFor(self->children[static_cast<std::size_t>(index)]);
}

int AccessibleNode::indexOfChild(const QAccessibleInterface* wanted) const {
    for (int i = 0; i < childCount(); ++i) {
        if (child(i) == wanted) {
            return i;
        }
    }
    return -1;
}

QAccessibleInterface* AccessibleNode::childAt(int x, int y) const {
    for (int i = 0; i < childCount(); ++i) {
        if (auto* candidate = child(i); candidate != nullptr && candidate->rect().contains(x, y)) {
            return candidate;
        }
    }
    return nullptr;
}

QString AccessibleNode::text(QAccessible::Text kind) const {
    return kind == QAccessible::Name ? QString::fromStdString(conversation_.nameOf(view_)) : QString();
}

QRect AccessibleNode::rect() const {
    const auto* self = entry();
    const auto view = self == nullptr ? nullptr : self->view.lock();
    if (!view) {
        return {};
    }
    const ConversationWidget& widget = conversation_.widget();
    const platform::Rect frame = view->frameInRoot();
    const QRectF here(frame.x, frame.y - widget.scrolled(), frame.width, frame.height);
    return here.toAlignedRect().translated(widget.mapToGlobal(QPoint(0, 0)));
}

QAccessible::Role AccessibleNode::role() const {
    const auto* self = entry();
    switch (self == nullptr ? AccessibilityRole::None : self->node.role) {
        case AccessibilityRole::Link:
            return QAccessible::Link;
        case AccessibilityRole::Text:
            return QAccessible::StaticText;
        case AccessibilityRole::Image:
            return QAccessible::Graphic;
        default:
            return QAccessible::Grouping;
    }
}

QAccessible::State AccessibleNode::state() const {
    QAccessible::State state;
    const auto* self = entry();
    if (self == nullptr) {
        state.invalid = true;
        return state;
    }
    const ConversationWidget& widget = conversation_.widget();
    const bool link = self->node.role == AccessibilityRole::Link;
    state.readOnly = true;
    state.linked = link;
    state.focusable = link;
    state.focused = link && widget.rows().focused().get() == view_;
    state.offscreen = !QRect(widget.mapToGlobal(QPoint(0, 0)), widget.size()).intersects(rect());
    return state;
}

void* AccessibleNode::interface_cast(QAccessible::InterfaceType type) {
    const auto* self = entry();
    if (type == QAccessible::ActionInterface && self != nullptr && self->node.pressable) {
        return static_cast<QAccessibleActionInterface*>(this);
    }
    return nullptr;
}

QStringList AccessibleNode::actionNames() const {
    const auto* self = entry();
    return self != nullptr && self->node.pressable ? QStringList{pressAction(), setFocusAction()} : QStringList{};
}

void AccessibleNode::doAction(const QString& name) {
    const auto* self = entry();
    if (self == nullptr || !self->node.pressable) {
        return;
    }
    if (name == pressAction()) {
        platform::accessibilityPress(self->node);
    } else if (name == setFocusAction()) {
        conversation_.widget().focusRow(view_);
    }
}

}  // namespace ktr::app
