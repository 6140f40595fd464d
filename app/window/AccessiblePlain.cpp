#include "app/window/AccessiblePlain.h"

namespace ktr::app {

void* AccessiblePlain::interface_cast(QAccessible::InterfaceType type) {
    return type == QAccessible::ActionInterface ? nullptr : QAccessibleWidget::interface_cast(type);
}

}  // namespace ktr::app
