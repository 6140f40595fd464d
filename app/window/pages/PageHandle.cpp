#include "app/window/pages/PageHandle.h"

#include "app/window/AccessiblePlain.h"

namespace ktr::app {

namespace {

QAccessibleInterface* handleOf(const QString& /*className*/, QObject* object) {
    auto* handle = dynamic_cast<PageHandle*>(object);
    return handle == nullptr ? nullptr : new AccessiblePlain(handle, QAccessible::ScrollBar);
}

}  // namespace

PageHandle::PageHandle(QWidget* parent) : QScrollBar(Qt::Vertical, parent) {
    // Again changes nothing.
    QAccessible::removeFactory(handleOf);
    QAccessible::installFactory(handleOf);
    setFocusPolicy(Qt::NoFocus);
    setCursor(Qt::ArrowCursor);
}

}  // namespace ktr::app
