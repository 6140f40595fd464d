#include "app/window/blocks/Block.h"

#include <QCoreApplication>
#include <QEvent>
#include <QPainter>
#include <algorithm>
#include <cmath>

#include "app/window/blocks/AccessibleBlock.h"
#include "platform/base/Platform.h"
#include "platform/ui/Device.h"

namespace ktr::app {

Block::Block(QWidget* parent) : QWidget(parent) {
    AccessibleBlock::install();
}

void Block::paintUnder(QPainter&, const QRectF&, host::CardShadow&) const {}

void Block::setLook(const Look& look) {
    look_ = look;
    for (QObject* child : children()) {
        if (auto* block = dynamic_cast<Block*>(child)) {
            block->setLook(look);
        }
    }
    lookChanged();
    update();
}

void Block::refresh() {
    for (QObject* child : children()) {
        if (auto* block = dynamic_cast<Block*>(child)) {
            block->refresh();
        }
    }
    refreshed();
    update();
}

void Block::placeShape(const QRect& shape) {
    const int out = around();
    setGeometry(shape.adjusted(-out, -out, out, out));
}

QRect Block::shape() const {
    const int out = around();
    return rect().adjusted(out, out, -out, -out);
}

QRectF Block::mirrored(const QRectF& rect) const {
    return isMirrored() ? QRectF(width() - rect.right(), rect.y(), rect.width(), rect.height()) : rect;
}

void Block::askForRoom() {
    if (parentWidget() != nullptr) {
        QCoreApplication::postEvent(parentWidget(), new QEvent(QEvent::LayoutRequest));
    }
    update();
}

bool Block::isVeryLarge() {
    const auto installed = platform::Platform::installed();
    return installed && platform::isAccessibilityCategory(installed->device->contentSizeCategory());
}

double Block::grown(double usual) {
    constexpr double kLargeControls = 1.6;
    return isVeryLarge() ? std::round(usual * kLargeControls) : usual;
}

QPainterPath rounded(const QRectF& rect, double corner) {
    const double radius = std::clamp(corner, 0.0, std::min(rect.width(), rect.height()) / 2.0);
    QPainterPath path;
    path.addRoundedRect(rect, radius, radius);
    return path;
}

void strokeInside(QPainter& painter, const QRectF& rect, double corner, const QPen& pen) {
    const double half = pen.widthF() / 2.0;
    if (half > 0.0) {
        painter.strokePath(rounded(rect.adjusted(half, half, -half, -half), corner - half), pen);
    }
}

}  // namespace ktr::app
