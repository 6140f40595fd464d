#include "app/window/SendButton.h"

#include <QPainter>
#include <QPainterPath>

namespace ktr::app {

namespace {

constexpr double kIcon = 20.0;
constexpr double kStroke = 2.0;
constexpr int kFrame = 16;  // milliseconds

QColor between(const QColor& from, const QColor& to, double share) {
    const auto mix = [share](int a, int b) { return qRound(a + (b - a) * share); };
    return {mix(from.red(), to.red()), mix(from.green(), to.green()), mix(from.blue(), to.blue())};
}

QPainterPath arrow() {
    QPainterPath path;
    path.moveTo(3.5, 10.0);
    path.lineTo(16.0, 10.0);
    path.moveTo(10.5, 4.5);
    path.lineTo(16.0, 10.0);
    path.lineTo(10.5, 15.5);
    return path;
}

}  // namespace

SendButton::SendButton(QWidget* parent)
    : QAbstractButton(parent), palette_(&linux_::Palette::of(linux_::ColorScheme::Light)) {
    clock_.start();
    setEnabled(false);
    setFocusPolicy(Qt::TabFocus);
    timer_.setInterval(kFrame);
    connect(&timer_, &QTimer::timeout, this, [this] {
        if (colour_.isOver(seconds())) {
            timer_.stop();
        }
        update();
    });
}

void SendButton::setColors(const linux_::Palette& palette) {
    palette_ = &palette;
    update();
}

void SendButton::setReady(bool ready, bool animated) {
    if (ready == isEnabled()) {
        return;
    }
    setEnabled(ready);
    setCursor(ready ? Qt::PointingHandCursor : Qt::ArrowCursor);
    const double now = seconds();
    const double to = ready ? 1.0 : 0.0;
    colour_ = animated ? host::Motion::linear(colour_.at(now), to, now, host::motions::kReady) : host::Motion(to);
    if (animated) {
        timer_.start();
    }
    update();
}

void SendButton::setStops(bool stops) {
    if (stops != stops_) {
        stops_ = stops;
        update();
    }
}

void SendButton::setMarksFocus(bool marks) {
    marksFocus_ = marks;
    update();
}

QSize SendButton::sizeHint() const {
    return {kDiameter + 2 * kAround, kDiameter + 2 * kAround};
}

void SendButton::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QPointF centre(width() / 2.0, height() / 2.0);
    const double ready = colour_.at(seconds());
    const double radius = kDiameter / 2.0;
    painter.setPen(Qt::NoPen);
    painter.setBrush(between(palette_->sendIdle, palette_->pine, ready));
    painter.drawEllipse(centre, radius, radius);
    painter.setBrush(Qt::NoBrush);
    if (const auto& edge = palette_->sendIdleEdge; edge.width > 0.0 && ready < 1.0) {
        painter.setPen(QPen(edge.color, edge.width));
        painter.drawEllipse(centre, radius - edge.width / 2.0, radius - edge.width / 2.0);
    }
    if (hasFocus() && marksFocus_) {
        const double half = palette_->focusRing / 2.0;
        painter.setPen(QPen(palette_->pine, palette_->focusRing));
        painter.drawEllipse(centre, radius + kAround - half - 1.0, radius + kAround - half - 1.0);
    }
    if (stops_) {
        constexpr double kStop = 12.0;
        constexpr double kStopCorner = 2.5;
        painter.setPen(Qt::NoPen);
        painter.setBrush(between(palette_->inkSoft, palette_->onPine, ready));
        painter.drawRoundedRect(QRectF(centre.x() - kStop / 2.0, centre.y() - kStop / 2.0, kStop, kStop), kStopCorner,
                                kStopCorner);
        return;
    }
    painter.translate(centre);
    if (layoutDirection() == Qt::RightToLeft) {
        painter.scale(-1.0, 1.0);
    }
    painter.translate(-kIcon / 2.0, -kIcon / 2.0);
    painter.setPen(
        QPen(between(palette_->inkSoft, palette_->onPine, ready), kStroke, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.drawPath(arrow());
}

}  // namespace ktr::app
