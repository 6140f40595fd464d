#include "host/conversation/CardShadow.h"

#include <QPaintEngine>
#include <QPainter>
#include <algorithm>
#include <array>
#include <cmath>

#include "host/conversation/Shapes.h"

namespace ktr::host {

namespace {

struct Layer {
    double dy, blur, spread;
};
/// Pixels a point of a shadow in a vector picture: it is soft, more would only make the file larger.
constexpr double kVectorScale = 2.0;

constexpr std::array<Layer, 2> kLayers = {{{1.0, 2.0, 0.0}, {8.0, 24.0, -6.0}}};

/// One pass of a moving average along a line of samples `stride` apart.
void average(std::vector<float>& samples, std::vector<float>& line, std::size_t start, std::size_t stride,
             std::size_t count, int radius) {
    for (std::size_t i = 0; i < count; ++i) {
        line[i] = samples[start + i * stride];
    }
    const auto at = [&](int i) {
        return i < 0 || i >= static_cast<int>(count) ? 0.0F : line[static_cast<std::size_t>(i)];
    };
    float sum = 0.0F;
    for (int i = -radius; i <= radius; ++i) {
        sum += at(i);
    }
    const float share = 1.0F / static_cast<float>(2 * radius + 1);
    for (int i = 0; i < static_cast<int>(count); ++i) {
        samples[start + static_cast<std::size_t>(i) * stride] = sum * share;
        sum += at(i + radius + 1) - at(i - radius);
    }
}

/// Three moving averages come within a few percent of a Gaussian (P. Kovesi, "Fast almost-Gaussian filtering", 2010);
/// the widths are chosen so that the variances add up.
void blur(std::vector<float>& samples, std::size_t side, double sigma) {
    const double ideal = std::sqrt(12.0 * sigma * sigma / 3.0 + 1.0);
    const int lower = static_cast<int>(ideal) % 2 == 0 ? static_cast<int>(ideal) - 1 : static_cast<int>(ideal);
    const int narrow = static_cast<int>(
        std::lround((12.0 * sigma * sigma - 3.0 * lower * lower - 12.0 * lower - 9.0) / (-4.0 * lower - 4.0)));
    std::vector<float> line(side);
    for (int pass = 0; pass < 3; ++pass) {
        const int radius = ((pass < narrow ? lower : lower + 2) - 1) / 2;
        for (std::size_t i = 0; i < side; ++i) {
            average(samples, line, i * side, 1, side, radius);
        }
        for (std::size_t i = 0; i < side; ++i) {
            average(samples, line, i, side, side, radius);
        }
    }
}

/// A stretch of pixels, [low, high), and where it stands: without those whole pixels of it that lie in `hidden`, if
/// that reaches over one of its ends. All in points.
struct Span {
    double low, high;
    double cutLow = 0.0, cutHigh = 0.0;

    void leaveOut(double hiddenLow, double hiddenHigh, double scale) {
        const auto whole = [scale](double points) { return std::max(std::floor(points * scale), 0.0) / scale; };
        if (hiddenLow > low && hiddenHigh >= high) {
            cutHigh = std::min(whole(high - hiddenLow), high - low);
        } else if (hiddenLow <= low && hiddenHigh < high) {
            cutLow = std::min(whole(hiddenHigh - low), high - low);
        }
    }
};

/// Leaves out what is hidden at the left or right of a piece that is one pixel to a pixel across.
void leaveOutAcross(const QRectF& hidden, double scale, QRectF& target, QRectF& source) {
    if (hidden.top() <= target.top() && hidden.bottom() >= target.bottom()) {
        Span span{target.left(), target.right()};
        span.leaveOut(hidden.left(), hidden.right(), scale);
        target.adjust(span.cutLow, 0.0, -span.cutHigh, 0.0);
        source.adjust(span.cutLow * scale, 0.0, -span.cutHigh * scale, 0.0);
    }
}

/// The same at the top or bottom.
void leaveOutDown(const QRectF& hidden, double scale, QRectF& target, QRectF& source) {
    QRectF turnedTarget(target.top(), target.left(), target.height(), target.width());
    QRectF turnedSource(source.top(), source.left(), source.height(), source.width());
    leaveOutAcross({hidden.top(), hidden.left(), hidden.height(), hidden.width()}, scale, turnedTarget, turnedSource);
    target.setRect(turnedTarget.top(), turnedTarget.left(), turnedTarget.height(), turnedTarget.width());
    source.setRect(turnedSource.top(), turnedSource.left(), turnedSource.height(), turnedSource.width());
}

}  // namespace

void CardShadow::paint(linux_::QtCanvas& canvas, const QRectF& card, double corner) {
    paintLayers(canvas, card, corner, {});
}

void CardShadow::paintAround(linux_::QtCanvas& canvas, const QRectF& card, double corner) {
    constexpr double kEdge = 1.0;  // points along which the card's own edge may be soft
    const bool isOpaque = canvas.painter().opacity() == 1.0;
    paintLayers(
        canvas, card, corner,
        isOpaque ? Hidden{card.adjusted(kEdge, corner, -kEdge, -corner), card.adjusted(corner, kEdge, -corner, -kEdge)}
                 : Hidden{});
}

void CardShadow::paintLayers(linux_::QtCanvas& canvas, const QRectF& card, double corner, const Hidden& hidden) {
    if (canvas.palette().cardShadow.alpha() == 0) {
        return;
    }
    for (const Layer& layer : kLayers) {
        const QRectF shape = card.adjusted(-layer.spread, -layer.spread, layer.spread, layer.spread);
        paintOne(canvas, shape.translated(0.0, layer.dy), std::max(corner + layer.spread, 0.0), layer.blur / 2.0,
                 hidden);
    }
}

const CardShadow::Blurred& CardShadow::blurred(double sigma, double corner, double scale, const QColor& color) {
    const auto found = std::find_if(kept_.begin(), kept_.end(), [&](const Blurred& b) {
        return b.sigma == sigma && b.corner == corner && b.scale == scale && b.color == color.rgba();
    });
    if (found != kept_.end()) {
        return *found;
    }
    Blurred made{sigma, corner, scale, color.rgba(), {}, std::ceil(3.0 * sigma * scale) / scale, 0.0};
    const double core = std::ceil((corner + made.margin) * scale) / scale;  // where a straight edge is reached
    made.edge = made.margin + core;
    const int side = static_cast<int>(std::lround(2.0 * made.edge * scale)) + 1;
    QImage mask(side, side, QImage::Format_ARGB32_Premultiplied);
    mask.fill(Qt::transparent);
    {
        QPainter painter(&mask);
        painter.setRenderHint(QPainter::Antialiasing);
        const double margin = made.margin * scale;
        painter.fillPath(roundedPath(QRectF(margin, margin, side - 2 * margin, side - 2 * margin), corner * scale),
                         Qt::black);
    }
    const auto size = static_cast<std::size_t>(side);
    std::vector<float> samples(size * size);
    for (int y = 0; y < side; ++y) {
        for (int x = 0; x < side; ++x) {
            samples[static_cast<std::size_t>(y) * size + static_cast<std::size_t>(x)] =
                static_cast<float>(qAlpha(mask.pixel(x, y))) / 255.0F;
        }
    }
    blur(samples, size, sigma * scale);
    for (int y = 0; y < side; ++y) {
        auto* line = reinterpret_cast<QRgb*>(mask.scanLine(y));
        for (int x = 0; x < side; ++x) {
            const float share = samples[static_cast<std::size_t>(y) * size + static_cast<std::size_t>(x)];
            line[x] = qPremultiply(qRgba(color.red(), color.green(), color.blue(),
                                         static_cast<int>(std::lround(share * static_cast<float>(color.alpha())))));
        }
    }
    made.image = std::move(mask);
    kept_.push_back(std::move(made));
    return kept_.back();
}

void CardShadow::paintOne(linux_::QtCanvas& canvas, const QRectF& shape, double corner, double sigma,
                          const Hidden& hidden) {
    QPainter& painter = canvas.painter();
    const auto engine = painter.paintEngine()->type();
    if (engine == QPaintEngine::Raster) {
        stretch(painter, blurred(sigma, corner, 1.0 / canvas.pixel(), canvas.palette().cardShadow), shape, hidden);
        return;
    }
    // Vector pictures get each shadow as one image: stretched pieces would show their seams, and some viewers take no
    // part of an image.
    const Blurred& b = blurred(sigma, corner, kVectorScale, canvas.palette().cardShadow);
    const QRectF outer = shape.adjusted(-b.margin, -b.margin, b.margin, b.margin);
    QImage whole(static_cast<int>(std::ceil(outer.width() * kVectorScale)),
                 static_cast<int>(std::ceil(outer.height() * kVectorScale)), QImage::Format_ARGB32_Premultiplied);
    whole.fill(Qt::transparent);
    {
        QPainter pixels(&whole);
        pixels.scale(kVectorScale, kVectorScale);
        pixels.translate(-outer.topLeft());
        stretch(pixels, b, shape, {});
    }
    painter.drawImage(QRectF(outer.topLeft(), QSizeF(whole.size()) / kVectorScale), whole);
}

void CardShadow::stretch(QPainter& painter, const Blurred& b, const QRectF& shape, const Hidden& hidden) {
    const double pixels = b.edge * b.scale;
    const QRectF outer = shape.adjusted(-b.margin, -b.margin, b.margin, b.margin);
    // A card too small for the corners squeezes them.
    const double edgeX = std::min(b.edge, outer.width() / 2.0);
    const double edgeY = std::min(b.edge, outer.height() / 2.0);
    const std::array<double, 4> xs = {outer.left(), outer.left() + edgeX, outer.right() - edgeX, outer.right()};
    const std::array<double, 4> ys = {outer.top(), outer.top() + edgeY, outer.bottom() - edgeY, outer.bottom()};
    const std::array<double, 4> from = {0.0, pixels, pixels + 1.0, 2.0 * pixels + 1.0};
    for (std::size_t row = 0; row < 3; ++row) {
        for (std::size_t column = 0; column < 3; ++column) {
            QRectF target(QPointF(xs[column], ys[row]), QPointF(xs[column + 1], ys[row + 1]));
            QRectF source(QPointF(from[column], from[row]), QPointF(from[column + 1], from[row + 1]));
            if (row == 1 && column != 1 && edgeX == b.edge) {
                leaveOutAcross(hidden.tall, b.scale, target, source);
            } else if (column == 1 && row != 1 && edgeY == b.edge) {
                leaveOutDown(hidden.wide, b.scale, target, source);
            }
            if (row == 1 && column == 1) {
                if (hidden.tall.contains(target)) {
                    continue;
                }
                // All of one colour, and as large as the card: stretching a pixel over it would cost more than all
                // else.
                const int centre = static_cast<int>(pixels);
                painter.fillRect(target, b.image.pixelColor(centre, centre));
            } else if (target.width() > 0.0 && target.height() > 0.0) {
                painter.drawImage(target, b.image, source);
            }
        }
    }
}

}  // namespace ktr::host
