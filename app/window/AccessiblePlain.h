#pragma once

#include <QAccessibleWidget>

namespace ktr::app {

/// A widget for assistive technology that cannot be pressed: it offers no actions, where the toolkit offers an empty
/// list of them for every widget, which checkers take for something that keys do not reach. Main thread.
class AccessiblePlain : public QAccessibleWidget {
  public:
    using QAccessibleWidget::QAccessibleWidget;

    void* interface_cast(QAccessible::InterfaceType type) override;
};

}  // namespace ktr::app
