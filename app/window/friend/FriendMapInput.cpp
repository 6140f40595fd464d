// What the map of a friend's page makes of wheel, mouse, fingers and keys.
#include <QKeyEvent>
#include <QMouseEvent>
#include <QTouchEvent>
#include <cmath>

#include "app/window/friend/FriendMap.h"

namespace ktr::app {

namespace {

constexpr double kArrow = 60.0;  ///< points a key goes
/// Doublings a notch of the wheel, in the eighths of a degree that Qt counts.
constexpr double kNotch = 120.0;
constexpr double kNotchSteps = 0.5;
constexpr double kPixelSteps = 1.0 / 240.0;
constexpr double kSlowest = 60.0;
constexpr double kFastest = 4000.0;  ///< points a second

QPointF whole(QPointF point) {
    return {std::round(point.x()), std::round(point.y())};
}

}  // namespace

void FriendMap::grab(QPointF at) {
    velocity_ = {};
    camera_.stop();
    frames_.stop();
    trail_.begin(at, seconds());
}

/// Lets go: a map that was moving runs on.
void FriendMap::letFly() {
    const double now = seconds();
    const QPointF speed = trail_.release(now);
    const double fast = std::hypot(speed.x(), speed.y());
    if (isStill_ || fast < kSlowest) {
        rest_.start();
        return;
    }
    velocity_ = speed * (std::min(fast, kFastest) / fast);
    flungAt_ = now;
    steppedAt_ = now;
    startMoving();
}

void FriendMap::mousePressEvent(QMouseEvent* event) {
    if (event->button() != Qt::LeftButton) {
        event->ignore();
        return;
    }
    held_ = event->position();
    grab(event->position());
    setCursor(Qt::ClosedHandCursor);
    isRingShown_ = false;
}

void FriendMap::mouseMoveEvent(QMouseEvent* event) {
    if (held_) {
        const QPointF by = whole(event->position() - *held_);
        if (!by.isNull()) {
            *held_ += by;
            trail_.move(event->position(), seconds());
            pan(by);
        }
    }
}

void FriendMap::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton && held_) {
        held_.reset();
        setCursor(Qt::OpenHandCursor);
        letFly();
    }
}

void FriendMap::mouseDoubleClickEvent(QMouseEvent* event) {
    if (event->button() == Qt::LeftButton) {
        constexpr double kStep = 0.2;  // seconds
        camera_.zoomOn(1.0, {event->position().x(), event->position().y()}, seconds(), isStill_ ? 0.0 : kStep);
        startMoving();
        touched();
    }
}

void FriendMap::wheelEvent(QWheelEvent* event) {
    const double steps = event->pixelDelta().isNull() ? event->angleDelta().y() / kNotch * kNotchSteps
                                                      : event->pixelDelta().y() * kPixelSteps;
    if (steps != 0.0) {
        zoom(steps, event->position());
    }
    event->accept();
}

void FriendMap::keyPressEvent(QKeyEvent* event) {
    switch (event->key()) {
        case Qt::Key_Left:
            return pan({kArrow, 0.0});
        case Qt::Key_Right:
            return pan({-kArrow, 0.0});
        case Qt::Key_Up:
            return pan({0.0, kArrow});
        case Qt::Key_Down:
            return pan({0.0, -kArrow});
        case Qt::Key_Plus:
        case Qt::Key_Equal:
            if ((event->modifiers() & Qt::ControlModifier) == 0) {
                return step(true);
            }
            break;
        case Qt::Key_Minus:
            if ((event->modifiers() & Qt::ControlModifier) == 0) {
                return step(false);
            }
            break;
        case Qt::Key_Home:
            return showPin();
        default:
            break;
    }
    // Such as the text size, and the way back.
    event->ignore();
}

void FriendMap::focusInEvent(QFocusEvent* event) {
    isRingShown_ = event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason;
    PlainWidget::focusInEvent(event);
    update();
}

void FriendMap::focusOutEvent(QFocusEvent* event) {
    PlainWidget::focusOutEvent(event);
    update();
}

bool FriendMap::event(QEvent* event) {
    switch (event->type()) {
        case QEvent::TouchBegin:
        case QEvent::TouchUpdate:
        case QEvent::TouchEnd:
        case QEvent::TouchCancel:
            return touch(*static_cast<QTouchEvent*>(event));
        default:
            return PlainWidget::event(event);
    }
}

/// One finger moves the map; two move it and make it larger or smaller between them. Further ones do nothing.
bool FriendMap::touch(QTouchEvent& event) {
    event.accept();
    std::vector<QPointF> down;
    for (const QEventPoint& point : event.points()) {
        if (point.state() != QEventPoint::Released && down.size() < 2) {
            down.push_back(mapFromGlobal(point.globalPosition()));
        }
    }
    const int fingers = event.type() == QEvent::TouchCancel ? 0 : static_cast<int>(down.size());
    if (fingers == 0) {
        if (fingers_ > 0) {
            letFly();
        }
        fingers_ = 0;
        return true;
    }
    const QPointF at = fingers == 1 ? down[0] : (down[0] + down[1]) / 2.0;
    const double span = fingers == 1 ? 0.0 : std::hypot(down[0].x() - down[1].x(), down[0].y() - down[1].y());
    if (fingers != fingers_) {
        // A finger that comes or goes moves nothing.
        fingers_ = fingers;
        pinchAt_ = at;
        pinchSpan_ = span;
        grab(at);
        return true;
    }
    const QPointF by = fingers == 1 ? whole(at - pinchAt_) : at - pinchAt_;
    if (!by.isNull()) {
        pinchAt_ += by;
        pan(by);
    }
    constexpr double kNarrow = 24.0;  // fingers on each other say nothing of a scale
    if (fingers == 2 && span > kNarrow && pinchSpan_ > kNarrow) {
        zoom(std::log2(span / pinchSpan_), at);
        pinchSpan_ = span;
        trail_.begin(at, seconds());
    } else {
        trail_.move(at, seconds());
    }
    return true;
}

}  // namespace ktr::app
