#include "app/window/blocks/PressBlock.h"

#include <QFocusEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>

namespace ktr::app {

namespace {

constexpr double kRingOutside = 3.0;

}  // namespace

PressBlock::PressBlock(QWidget* parent) : Block(parent) {
    setFocusPolicy(Qt::TabFocus);
    setAttribute(Qt::WA_Hover);
    setCursor(Qt::PointingHandCursor);
}

void PressBlock::press() {
    if (isEnabled() && pressed_) {
        // The page may go with all that is on it.
        const auto pressed = pressed_;
        pressed();
    }
}

void PressBlock::setDown(bool down) {
    if (down != down_) {
        down_ = down;
        update();
    }
}

bool PressBlock::event(QEvent* event) {
    if (event->type() == QEvent::HoverEnter || event->type() == QEvent::HoverLeave) {
        hovered_ = event->type() == QEvent::HoverEnter;
        update();
    }
    return Block::event(event);
}

void PressBlock::changeEvent(QEvent* event) {
    Block::changeEvent(event);
    if (event->type() == QEvent::EnabledChange) {
        setCursor(isEnabled() ? Qt::PointingHandCursor : Qt::ArrowCursor);
        down_ = false;
        update();
    }
}

void PressBlock::mousePressEvent(QMouseEvent* event) {
    if (event->button() != Qt::LeftButton) {
        event->ignore();
        return;
    }
    marked_ = false;
    setDown(true);
}

void PressBlock::mouseMoveEvent(QMouseEvent* event) {
    if ((event->buttons() & Qt::LeftButton) != 0) {
        setDown(rect().contains(event->position().toPoint()));
    }
}

void PressBlock::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() != Qt::LeftButton) {
        event->ignore();
        return;
    }
    const bool isMeant = isDown() && rect().contains(event->position().toPoint());
    setDown(false);
    if (isMeant) {
        press();
    }
}

void PressBlock::keyPressEvent(QKeyEvent* event) {
    switch (event->key()) {
        case Qt::Key_Space:
        case Qt::Key_Select:
            setDown(true);
            break;
        case Qt::Key_Return:
        case Qt::Key_Enter:
            if (!event->isAutoRepeat()) {
                press();
            }
            break;
        default:
            Block::keyPressEvent(event);
    }
}

void PressBlock::keyReleaseEvent(QKeyEvent* event) {
    const bool isSpace = event->key() == Qt::Key_Space || event->key() == Qt::Key_Select;
    if (!isSpace || event->isAutoRepeat()) {
        Block::keyReleaseEvent(event);
        return;
    }
    const bool isMeant = isDown();
    setDown(false);
    if (isMeant) {
        press();
    }
}

void PressBlock::focusInEvent(QFocusEvent* event) {
    Block::focusInEvent(event);
    const auto reason = event->reason();
    marked_ = reason == Qt::TabFocusReason || reason == Qt::BacktabFocusReason || reason == Qt::ShortcutFocusReason;
    update();
}

void PressBlock::focusOutEvent(QFocusEvent* event) {
    Block::focusOutEvent(event);
    down_ = false;
    update();
}

void PressBlock::paintRing(QPainter& painter, const QRectF& shape, double corner) const {
    if (marksFocus()) {
        const double width = colors().focusRing;
        // The gap stays, also where the ring is wider.
        const double out = kRingOutside + width;
        const double inside = std::min(out, static_cast<double>(around()));
        strokeInside(painter, shape.adjusted(-inside, -inside, inside, inside), corner + inside,
                     QPen(colors().pine, width));
    }
}

void PressBlock::paintTouch(QPainter& painter, const QPainterPath& shape) const {
    if (isHovered()) {
        painter.fillPath(shape, colors().highlight);
    }
    if (isDown()) {
        painter.fillPath(shape, linux_::Palette::pressed());
    }
}

}  // namespace ktr::app
