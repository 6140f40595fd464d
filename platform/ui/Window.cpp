#include "platform/ui/Window.h"

namespace ktr::platform {

WindowClient::~WindowClient() = default;

void Window::needsDisplay(const Rect& rect) {
    if (const auto client = client_.lock()) {
        client->windowNeedsDisplay(rect);
    }
}

void Window::needsLayout() {
    if (const auto client = client_.lock()) {
        client->windowNeedsLayout();
    }
}

}  // namespace ktr::platform
