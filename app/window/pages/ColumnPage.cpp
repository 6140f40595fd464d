#include "app/window/pages/ColumnPage.h"

#include <QEvent>
#include <QScroller>
#include <algorithm>

#include "app/window/ScrollBarStyle.h"

namespace ktr::app {

namespace {

constexpr int kGutter = 12;
constexpr int kBelowLower = 16;
constexpr int kAboveLower = 8;

}  // namespace

ColumnPage::ColumnPage(Bar bar, QWidget* parent)
    : Page(parent), area_(new PageArea(this)), handle_(new PageHandle(this)), column_(new Column) {
    if (bar == Bar::With) {
        bar_ = new PageBar(this);
        bar_->setBack([this] { leave(); });
        setTabOrder(&bar_->back(), area_);
    }
    area_->setWidget(column_);
    column_->setAutoFillBackground(false);
    column_->installEventFilter(this);
    area_->viewport()->installEventFilter(this);
    QScroller::grabGesture(area_->viewport(), QScroller::TouchGesture);
    QScrollBar* scrolled = area_->verticalScrollBar();
    connect(scrolled, &QScrollBar::rangeChanged, &listener_, [this](int least, int most) {
        handle_->setRange(least, most);
        handle_->setVisible(most > least);
    });
    connect(scrolled, &QScrollBar::valueChanged, &listener_, [this](int value) { handle_->setValue(value); });
    connect(handle_, &QScrollBar::valueChanged, &listener_, [scrolled](int value) { scrolled->setValue(value); });
    handle_->hide();
}

void ColumnPage::setLower(Block* lower) {
    lower_ = lower;
    lower_->setParent(this);
    lower_->setLook(look());
    lower_->show();
    place();
}

void ColumnPage::reveal(const QWidget& block) {
    constexpr int kAround = 24;
    area_->ensureWidgetVisible(const_cast<QWidget*>(&block), 0, kAround);
}

void ColumnPage::lookChanged() {
    column_->setLook(look());
    handle_->setStyleSheet(scrollBarStyle(colors()));
}

void ColumnPage::refreshed() {
    column_->refresh();
    place();
}

void ColumnPage::resizeEvent(QResizeEvent*) {
    place();
}

bool ColumnPage::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        return true;
    }
    return Page::event(event);
}

bool ColumnPage::eventFilter(QObject* object, QEvent* event) {
    const bool hasOtherRoom = object == area_->viewport() && event->type() == QEvent::LayoutRequest;
    if (hasOtherRoom || (object == column_ && event->type() == QEvent::LayoutDirectionChange)) {
        place();
    }
    return Page::eventFilter(object, event);
}

int ColumnPage::placeLower(int above, int columnHeight) {
    if (lower_ == nullptr) {
        return 0;
    }
    const int across = std::min(width(), mostWidth()) - 2 * kGutter;
    const int high = lower_->shapeHeight(across);
    const int all = kAboveLower + high + kBelowLower;
    const bool isFixed = height() - above - all >= all;
    moveLower(isFixed ? static_cast<QWidget*>(this) : column_);
    const int y = isFixed ? height() - kBelowLower - high : columnHeight + kAboveLower;
    lower_->placeShape({(width() - across) / 2, y, across, high});
    return all;
}

void ColumnPage::moveLower(QWidget* parent) {
    if (lower_->parentWidget() == parent) {
        return;
    }
    // What is moved is hidden on the way, and a button in it would lose the focus.
    QWidget* const last = focusWidget();
    QWidget* const focused = last != nullptr && last->hasFocus() && lower_->isAncestorOf(last) ? last : nullptr;
    lower_->setParent(parent);
    lower_->show();
    if (focused != nullptr) {
        focused->setFocus(Qt::OtherFocusReason);
    }
}

void ColumnPage::place() {
    const int above = bar_ == nullptr ? 0 : bar_->shapeHeight(width());
    if (bar_ != nullptr) {
        bar_->placeShape({0, 0, width(), above});
    }
    column_->setMostWidth(mostWidth());
    const int wanted = column_->shapeHeight(width());
    const int lower = placeLower(above, wanted);
    const bool isFixed = lower_ != nullptr && lower_->parentWidget() == this;
    const int room = std::max(height() - above - (isFixed ? lower : 0), 0);
    area_->setGeometry(0, above, width(), room);
    column_->resize(width(), std::max(wanted + (isFixed ? 0 : lower), room));
    QScrollBar* scrolled = area_->verticalScrollBar();
    handle_->setPageStep(room);
    handle_->setRange(scrolled->minimum(), scrolled->maximum());
    handle_->setVisible(scrolled->maximum() > scrolled->minimum());
    handle_->setGeometry(isMirrored() ? 0 : width() - kScrollBarWidth, above, kScrollBarWidth, room);
    handle_->raise();
}

}  // namespace ktr::app
