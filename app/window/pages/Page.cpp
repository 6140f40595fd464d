#include "app/window/pages/Page.h"

#include <QPaintEvent>
#include <QPainter>

namespace ktr::app {

void Page::paintEvent(QPaintEvent* event) {
    QPainter painter(this);
    painter.fillRect(event->rect(), colors().window);
}

}  // namespace ktr::app
