#include "app/window/PlainWidget.h"

#include "app/window/AccessiblePlain.h"

namespace ktr::app {

namespace {

QAccessibleInterface* plainOf(const QString& /*className*/, QObject* object) {
    auto* plain = dynamic_cast<PlainWidget*>(object);
    return plain == nullptr ? nullptr : new AccessiblePlain(plain, QAccessible::Client);
}

}  // namespace

PlainWidget::PlainWidget(QWidget* parent) : QWidget(parent) {
    // Again changes nothing.
    QAccessible::removeFactory(plainOf);
    QAccessible::installFactory(plainOf);
}

}  // namespace ktr::app
