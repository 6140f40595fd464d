#include "host/conversation/RingView.h"

#include <QPainter>

#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"

namespace ktr::host {

void RingView::setTurn(double turn) {
    if (turn != turn_) {
        turn_ = turn;
        setNeedsDisplay();
    }
}

void RingView::setShare(double share) {
    if (share != share_) {
        share_ = share;
        setNeedsDisplay();
    }
}

void RingView::draw(platform::Canvas& canvas) const {
    if (auto* qt = qtCanvas(canvas)) {
        paint(qt->painter(), toQt(bounds()), qt->palette().pine, turn_, share_);
    }
}

void RingView::paint(QPainter& painter, const QRectF& box, const QColor& color, double turn, double share) {
    constexpr double kTrackAlpha = 0.2;
    const double half = measures::kRingStroke / 2.0;
    const QRectF circle = box.adjusted(half, half, -half, -half);
    QColor track = color;
    track.setAlphaF(static_cast<float>(kTrackAlpha));
    QPainterPath whole;
    whole.addEllipse(circle);
    painter.strokePath(whole, QPen(track, measures::kRingStroke));
    // Qt counts angles from three o'clock, counter-clockwise.
    const double start = 90.0 - 360.0 * turn;
    QPainterPath arc;
    arc.arcMoveTo(circle, start);
    arc.arcTo(circle, start, -360.0 * share);
    painter.strokePath(arc, QPen(color, measures::kRingStroke, Qt::SolidLine, Qt::RoundCap));
}

}  // namespace ktr::host
