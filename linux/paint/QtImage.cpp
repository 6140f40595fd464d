#include "linux/paint/QtImage.h"

#include <QPaintEngine>
#include <QPainter>
#include <QTransform>
#include <algorithm>
#include <cmath>

namespace ktr::linux_ {

double QtImage::pixelsPerUnit(const QPainter& painter) {
    constexpr double kVectorResolution = 4.0;
    const QTransform t = painter.deviceTransform();
    const double scale = std::max(std::hypot(t.m11(), t.m12()), std::hypot(t.m21(), t.m22()));
    const QPaintEngine* engine = painter.paintEngine();
    const bool raster = engine == nullptr || engine->type() == QPaintEngine::Raster;
    return raster ? scale : std::max(scale, kVectorResolution);
}

}  // namespace ktr::linux_
