#include "app/window/blocks/AccessibleBlock.h"

namespace ktr::app {

namespace {

QAccessibleInterface* accessibleOf(const QString& /*className*/, QObject* object) {
    auto* block = dynamic_cast<Block*>(object);
    return block == nullptr ? nullptr : new AccessibleBlock(*block);
}

}  // namespace

void AccessibleBlock::install() {
    QAccessible::removeFactory(accessibleOf);
    QAccessible::installFactory(accessibleOf);
}

QAccessible::State AccessibleBlock::state() const {
    QAccessible::State state = AccessiblePlain::state();
    state.checkable = block_.isCheckable();
    state.checked = block_.isChecked();
    // Also while it is switched off: keys will reach it.
    state.focusable = canBePressed();
    return state;
}

void* AccessibleBlock::interface_cast(QAccessible::InterfaceType type) {
    // What cannot be pressed has no actions, not an empty list of them. The plain kind never has any.
    return type == QAccessible::ActionInterface && canBePressed()
               ? QAccessibleWidget::interface_cast(type)  // NOLINT(bugprone-parent-virtual-call)
               : AccessiblePlain::interface_cast(type);
}

QStringList AccessibleBlock::actionNames() const {
    if (!canBePressed() || !block_.isEnabled()) {
        return {};
    }
    return {block_.isCheckable() ? toggleAction() : pressAction(), setFocusAction()};
}

void AccessibleBlock::doAction(const QString& name) {
    if (!block_.isEnabled()) {
        return;
    }
    if (name == setFocusAction()) {
        block_.setFocus(Qt::OtherFocusReason);
    } else if (canBePressed() && (name == pressAction() || name == toggleAction())) {
        block_.press();
    }
}

}  // namespace ktr::app
