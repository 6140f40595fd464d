#include "app/window/pages/PageArea.h"

#include "app/window/AccessiblePlain.h"
#include "app/window/PlainWidget.h"

namespace ktr::app {

namespace {

class Reading : public AccessiblePlain {
  public:
    explicit Reading(PageArea& area) : AccessiblePlain(&area, QAccessible::Client), area_(area) {}
    int childCount() const override { return 1; }
    QAccessibleInterface* child(int index) const override {
        return index == 0 ? QAccessible::queryAccessibleInterface(area_.viewport()) : nullptr;
    }
    int indexOfChild(const QAccessibleInterface* wanted) const override {
        return wanted != nullptr && wanted->object() == area_.viewport() ? 0 : -1;
    }

  private:
    PageArea& area_;
};

QAccessibleInterface* readingOf(const QString& /*className*/, QObject* object) {
    auto* area = dynamic_cast<PageArea*>(object);
    return area == nullptr ? nullptr : new Reading(*area);
}

}  // namespace

PageArea::PageArea(QWidget* parent) : QScrollArea(parent) {
    // Again changes nothing.
    QAccessible::removeFactory(readingOf);
    QAccessible::installFactory(readingOf);
    setViewport(new PlainWidget(this));
    setFrameShape(QFrame::NoFrame);
    setFocusPolicy(Qt::NoFocus);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    // The bar lies over the page, as it does over a conversation.
    setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    viewport()->setAutoFillBackground(false);
}

}  // namespace ktr::app
