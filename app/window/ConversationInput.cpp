// What the conversation makes of wheel, mouse, finger and keys.
#include <QClipboard>
#include <QContextMenuEvent>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QMenu>
#include <QMouseEvent>
#include <QTouchEvent>
#include <algorithm>
#include <cmath>

#include "app/window/AccessibleConversation.h"
#include "app/window/ConversationWidget.h"

namespace ktr::app {

namespace {

constexpr double kArrowStep = 40.0;
/// A wheel's notch, in the eighths of a degree that Qt counts, and how far it goes in points.
constexpr double kNotch = 120.0;
constexpr double kNotchStep = 60.0;

}  // namespace

// Pointers

void ConversationWidget::wheelEvent(QWheelEvent* event) {
    stopScrolling();
    kinetic_.stop();
    const double pixels = event->pixelDelta().isNull() ? event->angleDelta().y() / kNotch * kNotchStep
                                                       : static_cast<double>(event->pixelDelta().y());
    // A fine wheel turns by less than a pixel at a time.
    wheelRest_ -= pixels;
    const double whole = std::trunc(wheelRest_);
    wheelRest_ -= whole;
    scrollTo(scrolled() + whole);
    rows_.hover(inTree(event->position()));
    event->accept();
}

void ConversationWidget::mousePressEvent(QMouseEvent* event) {
    rows_.clear();
    if (event->button() == Qt::LeftButton) {
        touches_->press(inTree(event->position()), seconds());
    }
}

void ConversationWidget::mouseMoveEvent(QMouseEvent* event) {
    touches_->move(inTree(event->position()), seconds());
    rows_.hover(inTree(event->position()));
}

void ConversationWidget::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton) {
        touches_->release(inTree(event->position()), seconds());
    }
}

void ConversationWidget::leaveEvent(QEvent*) {
    rows_.hover(std::nullopt);
}

bool ConversationWidget::event(QEvent* event) {
    switch (event->type()) {
        case QEvent::TouchBegin:
        case QEvent::TouchUpdate:
        case QEvent::TouchEnd:
        case QEvent::TouchCancel:
            return touch(*static_cast<QTouchEvent*>(event));
        default:
            return QWidget::event(event);
    }
}

bool ConversationWidget::touch(QTouchEvent& event) {
    if (event.points().isEmpty()) {
        return false;
    }
    // One finger scrolls and taps; further ones do nothing.
    const QPointF at = mapFromGlobal(event.points().first().globalPosition());
    event.accept();
    switch (event.type()) {
        case QEvent::TouchBegin:
            stopScrolling();
            rows_.clear();
            rows_.hover(std::nullopt);
            // A finger that stops a fling taps nothing.
            tap_ = kinetic_.isFlinging() ? std::nullopt : std::optional(at);
            kinetic_.press(at.y(), seconds());
            if (tap_) {
                touches_->press(inTree(at), seconds());
                holdTimer_.start();
            }
            break;
        case QEvent::TouchUpdate: {
            const double moved = kinetic_.drag(at.y(), seconds());
            if (tap_ && std::hypot(at.x() - tap_->x(), at.y() - tap_->y()) > platform::TouchDispatcher::kSlop) {
                touches_->cancel(seconds());
                tap_.reset();
                holdTimer_.stop();
            }
            if (!tap_) {
                scrollTo(scrolled() + moved);
            }
            break;
        }
        case QEvent::TouchEnd:
            holdTimer_.stop();
            if (tap_) {
                kinetic_.stop();
                touches_->release(inTree(at), seconds());
            } else {
                kinetic_.release(seconds());
                if (kinetic_.isFlinging()) {
                    flingTimer_.start();
                }
            }
            tap_.reset();
            break;
        default:
            holdTimer_.stop();
            touches_->cancel(seconds());
            tap_.reset();
            break;
    }
    return true;
}

void ConversationWidget::fling() {
    const int before = bar_->value();
    wheelRest_ += kinetic_.step(seconds());
    const double whole = std::trunc(wheelRest_);
    wheelRest_ -= whole;
    scrollTo(before + whole);
    const bool atEnd = std::abs(whole) >= 1.0 && bar_->value() == before;
    if (atEnd) {
        kinetic_.stop();
    }
    if (!kinetic_.isFlinging()) {
        wheelRest_ = 0.0;
        flingTimer_.stop();
    }
}

// Copying

namespace {

/// The text of the innermost element at a point.
std::string textIn(const platform::AccessibilityNode& node, const platform::Point& at) {
    for (const auto& child : node.children) {
        if (child.frame.contains(at)) {
            if (std::string text = textIn(child, at); !text.empty()) {
                return text;
            }
        }
    }
    return node.children.empty() && node.role != platform::AccessibilityRole::Group ? node.text : "";
}

}  // namespace

std::string ConversationWidget::textAt(QPointF point) const {
    return textIn(platform::accessibilityTree(host_.window(), host_.rightToLeft()), inTree(point));
}

void ConversationWidget::offerCopy(const std::string& text, QPoint at) {
    if (text.empty()) {
        return;
    }
    auto* menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    const QString copied = QString::fromStdString(text);
    connect(menu->addAction(QString::fromStdString(host_.text("MENU_COPY"))), &QAction::triggered, menu,
            [copied] { QGuiApplication::clipboard()->setText(copied); });
    menu->popup(at);
}

void ConversationWidget::contextMenuEvent(QContextMenuEvent* event) {
    const bool isByKey = event->reason() == QContextMenuEvent::Keyboard;
    const auto focused = isByKey ? rows_.focusedRect() : std::nullopt;
    if (isByKey && !focused) {
        return;
    }
    // Inside the row: at its very edge another one may begin.
    const QPointF at = isByKey
                           ? QPointF(focused->x + focused->width / 2.0, focused->y + focused->height / 2.0 - scrolled())
                           : QPointF(event->pos());
    offerCopy(textAt(at), mapToGlobal(at.toPoint()));
}

void ConversationWidget::held() {
    if (tap_) {
        const QPointF at = *tap_;
        // What began as a tap on a row is none any more.
        touches_->cancel(seconds());
        tap_.reset();
        kinetic_.stop();
        offerCopy(textAt(at), mapToGlobal(at.toPoint()));
    }
}

// Keyboard

void ConversationWidget::showFocus() {
    stopScrolling();
    constexpr double kAround = 12.0;
    if (const auto rect = rows_.focusedRect()) {
        if (rect->y - kAround < scrolled()) {
            scrollTo(rect->y - kAround);
        } else if (rect->maxY() + kAround > scrolled() + height()) {
            scrollTo(rect->maxY() + kAround - height());
        }
        AccessibleConversation::focused(*this);
    }
}

bool ConversationWidget::focusNextPrevChild(bool next) {
    if (rows_.step(next)) {
        showFocus();
        return true;
    }
    return QWidget::focusNextPrevChild(next);
}

void ConversationWidget::focusInEvent(QFocusEvent* event) {
    QWidget::focusInEvent(event);
    // Where there is no row to stop at, the focus goes on to whatever is next.
    if (event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason) {
        focusNextPrevChild(event->reason() == Qt::TabFocusReason);
    }
}

void ConversationWidget::focusOutEvent(QFocusEvent* event) {
    QWidget::focusOutEvent(event);
    // Who comes back to the window goes on where they were.
    if (event->reason() != Qt::ActiveWindowFocusReason && event->reason() != Qt::PopupFocusReason) {
        rows_.clear();
    }
}

bool ConversationWidget::focusRow(const platform::View* row) {
    if (!rows_.focus(row)) {
        return false;
    }
    setFocus(Qt::OtherFocusReason);
    showFocus();
    return true;
}

bool ConversationWidget::moveAmongRows(int key) {
    if (!rows_.hasFocus()) {
        return false;
    }
    bool moved = false;
    switch (key) {
        case Qt::Key_Down:
        case Qt::Key_Up:
            moved = rows_.stepWithin(key == Qt::Key_Down);
            break;
        case Qt::Key_Home:
        case Qt::Key_End:
            moved = rows_.goToEnd(key == Qt::Key_End);
            break;
        default:
            break;
    }
    if (moved) {
        showFocus();
    }
    return moved;
}

void ConversationWidget::keyPressEvent(QKeyEvent* event) {
    stopScrolling();
    const double page = height() - kArrowStep;
    // Taken here and not as shortcuts: those need a window manager that says which window is active.
    if (event->modifiers() == Qt::ControlModifier && (event->key() == Qt::Key_Q || event->key() == Qt::Key_W)) {
        window()->close();
        return;
    }
    if (event->matches(QKeySequence::Copy)) {
        if (const auto row = rows_.focusedRect()) {
            QGuiApplication::clipboard()->setText(
                QString::fromStdString(textAt({row->x + row->width / 2.0, row->y + row->height / 2.0 - scrolled()})));
        }
        return;
    }
    if (moveAmongRows(event->key())) {
        return;
    }
    switch (event->key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
        case Qt::Key_Space:
            if (!rows_.press() && event->key() == Qt::Key_Space) {
                scrollTo(scrolled() + (event->modifiers().testFlag(Qt::ShiftModifier) ? -page : page));
            }
            return;
        case Qt::Key_Escape:
            rows_.clear();
            // The window may have somewhere to go back to.
            return event->ignore();
        case Qt::Key_Down:
            return scrollTo(scrolled() + kArrowStep);
        case Qt::Key_Up:
            return scrollTo(scrolled() - kArrowStep);
        case Qt::Key_PageDown:
            return scrollTo(scrolled() + page);
        case Qt::Key_PageUp:
            return scrollTo(scrolled() - page);
        case Qt::Key_Home:
            return scrollTo(0.0);
        case Qt::Key_End:
            return scrollTo(bar_->maximum());
        default:
            QWidget::keyPressEvent(event);
    }
}

}  // namespace ktr::app
