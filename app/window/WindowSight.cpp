#include "app/window/WindowSight.h"

#include <QEvent>
#include <QWidget>
#include <QWindow>
#include <utility>

namespace ktr::app {

WindowSight::WindowSight(QWidget& window, std::function<bool()> isLocked)
    : window_(window), isLocked_(std::move(isLocked)) {
    window_.installEventFilter(this);
    findHandle();
}

WindowSight::~WindowSight() = default;

void WindowSight::findHandle() {
    QWindow* const handle = window_.windowHandle();
    if (handle == handle_ || handle == nullptr) {
        return;
    }
    handle_ = handle;
    handle_->installEventFilter(this);
    workspace_ = std::make_unique<X11Workspace>(static_cast<std::uint32_t>(handle_->winId()), [this] { look(); });
}

void WindowSight::look() {
    wasExposed_ = wasExposed_ || (handle_ != nullptr && handle_->isExposed());
    const bool isOnScreen = !wasExposed_ || (window_.isVisible() && handle_->isExposed());
    const bool isSeen = isOnScreen && !window_.isMinimized() && (!workspace_ || workspace_->isShown()) && !isLocked_();
    if (std::exchange(isSeen_, isSeen) != isSeen && changed_) {
        changed_();
    }
}

bool WindowSight::eventFilter(QObject* object, QEvent* event) {
    switch (event->type()) {
        case QEvent::Show:
        case QEvent::WinIdChange:
            findHandle();
            look();
            break;
        case QEvent::Hide:
        case QEvent::Expose:
        case QEvent::WindowStateChange:
            // What the event says holds once it has been handled.
            QMetaObject::invokeMethod(
                this, [this] { look(); }, Qt::QueuedConnection);
            break;
        default:
            break;
    }
    return QObject::eventFilter(object, event);
}

}  // namespace ktr::app
