#include "host/conversation/Motion.h"

#include <QEasingCurve>
#include <QPointF>
#include <algorithm>

namespace ktr::host {

double Motion::at(double now) const {
    static const QEasingCurve curve = [] {
        QEasingCurve made(QEasingCurve::BezierSpline);
        made.addCubicBezierSegment({0.2, 0.0}, {0.0, 1.0}, {1.0, 1.0});
        return made;
    }();
    if (isOver(now)) {
        return to_;
    }
    const double share = std::clamp((now - start_) / duration_, 0.0, 1.0);
    return from_ + (to_ - from_) * (eased_ ? curve.valueForProgress(share) : share);
}

}  // namespace ktr::host
