#include "app/window/AccessibleWidget.h"

#include "app/window/ConversationWidget.h"

namespace ktr::app {

AccessibleWidget::AccessibleWidget(ConversationWidget& widget, AccessibleConversation& conversation)
    : QAccessibleWidget(&widget, QAccessible::Document), conversation_(conversation) {}

int AccessibleWidget::childCount() const {
    return static_cast<int>(conversation_.topLevel().size());
}

QAccessibleInterface* AccessibleWidget::child(int index) const {
    if (index < 0 || index >= childCount()) {
        return nullptr;
    }
    return conversation_.interfaceFor(conversation_.topLevel()[static_cast<std::size_t>(index)]);
}

int AccessibleWidget::indexOfChild(const QAccessibleInterface* wanted) const {
    for (int i = 0; i < childCount(); ++i) {
        if (child(i) == wanted) {
            return i;
        }
    }
    return -1;
}

QAccessibleInterface* AccessibleWidget::childAt(int x, int y) const {
    for (int i = 0; i < childCount(); ++i) {
        if (auto* candidate = child(i); candidate != nullptr && candidate->rect().contains(x, y)) {
            return candidate;
        }
    }
    return nullptr;
}

}  // namespace ktr::app
