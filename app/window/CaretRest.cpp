#include "app/window/CaretRest.h"

#include <QApplication>
#include <QEvent>
#include <QStyleHints>
#include <utility>

namespace ktr::app {

CaretRest::CaretRest(int milliseconds) {
    timer_.setSingleShot(true);
    timer_.setInterval(milliseconds);
    connect(&timer_, &QTimer::timeout, this, [this] { rest(); });
    qApp->installEventFilter(this);
    timer_.start();
}

CaretRest::~CaretRest() {
    wake();
}

void CaretRest::rest() {
    if (flashTime_ == 0) {
        flashTime_ = QGuiApplication::styleHints()->cursorFlashTime();
        QApplication::setCursorFlashTime(0);
    }
}

void CaretRest::wake() {
    if (const int time = std::exchange(flashTime_, 0); time > 0) {
        QApplication::setCursorFlashTime(time);
    }
}

bool CaretRest::eventFilter(QObject* object, QEvent* event) {
    switch (event->type()) {
        case QEvent::KeyPress:
        case QEvent::InputMethod:
        case QEvent::MouseButtonPress:
        case QEvent::TouchBegin:
        case QEvent::FocusIn:
            wake();
            timer_.start();
            break;
        default:
            break;
    }
    return QObject::eventFilter(object, event);
}

}  // namespace ktr::app
