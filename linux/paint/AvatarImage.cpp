#include "linux/paint/AvatarImage.h"

#include <QGlyphRun>
#include <QPainter>
#include <QRawFont>
#include <QTextLayout>
#include <algorithm>
#include <array>
#include <cmath>

#include "linux/paint/FontChoice.h"
#include "linux/paint/PersonColors.h"
#include "linux/paint/ShapeRecipe.h"

namespace ktr::linux_ {

namespace {

/// Letters may take this part of the diameter.
constexpr double kWidest = 0.74;
/// Outlines are taken at this size and scaled.
constexpr int kOutlineSize = 200;
constexpr double kFigure = 54.0;

struct LetterSize {
    double diameter;
    double size;
};
constexpr std::array kLetterSizes = {LetterSize{42, 19}, LetterSize{54, 22}, LetterSize{58, 27}, LetterSize{72, 41},
                                     LetterSize{89, 50}};

struct Outline {
    QPainterPath path;   ///< baseline at 0, the letters' advance centred on x = 0; at kOutlineSize
    double advance = 0;  ///< at kOutlineSize
};

Outline outlineOf(const QString& letters) {
    ShapeRecipe recipe;
    recipe.text = letters;
    const auto stretches = FontChoice().stretches(letters);
    recipe.font = {stretches.empty() ? FontChoice::baseFamily() : stretches.front().family, kOutlineSize, QFont::Bold};
    recipe.direction = letters.isRightToLeft() ? Qt::RightToLeft : Qt::LeftToRight;
    const auto layout = recipe.layout({{kOutlineSize * 100.0, QPointF()}});
    const QTextLine line = layout->lineAt(0);
    Outline outline;
    outline.advance = line.naturalTextWidth();
    for (const QGlyphRun& run : line.glyphRuns()) {
        const QRawFont font = run.rawFont();
        const auto glyphs = run.glyphIndexes();
        const auto positions = run.positions();
        for (qsizetype i = 0; i < glyphs.size(); ++i) {
            if (glyphs[i] == 0) {
                return {};  // no font has the letter
            }
            outline.path.addPath(font.pathForGlyph(glyphs[i]).translated(positions[i]));
        }
    }
    outline.path.translate(-outline.advance / 2.0, -line.y() - line.ascent());
    outline.path.setFillRule(Qt::WindingFill);
    return outline;
}

/// Head and shoulders, in a circle of 54.
QPainterPath figure() {
    QPainterPath head;
    head.addEllipse(QPointF(27.0, 21.5), 8.5, 8.5);
    QPainterPath shoulders(QPointF(9.5, 54.0));
    shoulders.cubicTo(9.5, 41.0, 17.0, 35.0, 27.0, 35.0);
    shoulders.cubicTo(37.0, 35.0, 44.5, 41.0, 44.5, 54.0);
    shoulders.closeSubpath();
    QPainterPath circle;
    circle.addEllipse(0.0, 0.0, kFigure, kFigure);
    return head.united(shoulders.intersected(circle));
}

}  // namespace

double AvatarImage::letterSizeFor(double diameter) {
    const LetterSize& first = kLetterSizes.front();
    const LetterSize& last = kLetterSizes.back();
    if (diameter <= first.diameter) {
        return std::max(1.0, std::round(diameter * first.size / first.diameter));
    }
    if (diameter >= last.diameter) {
        return std::round(diameter * last.size / last.diameter);
    }
    std::size_t i = 1;
    while (kLetterSizes[i].diameter < diameter) {
        ++i;
    }
    const LetterSize& low = kLetterSizes[i - 1];
    const LetterSize& high = kLetterSizes[i];
    const double part = (diameter - low.diameter) / (high.diameter - low.diameter);
    return std::round(low.size + part * (high.size - low.size));
}

std::shared_ptr<AvatarImage> AvatarImage::letters(double diameter, const Initials& initials, const QColor& color,
                                                  double letterSize) {
    const Outline outline = outlineOf(initials.letters());
    // Without an outline (a letter that no font has, or a font made of pictures) there is nothing to show.
    if (initials.letters().isEmpty() || outline.path.isEmpty() || outline.advance <= 0.0) {
        return blank(diameter);
    }
    double size = letterSize > 0.0 ? letterSize : letterSizeFor(diameter);
    while (size > 1.0 && outline.advance / kOutlineSize * size > kWidest * diameter) {
        size -= 1.0;
    }
    auto image = std::shared_ptr<AvatarImage>(new AvatarImage(diameter));
    image->letterSize_ = size;
    image->color_ = color;
    QTransform place;
    place.translate(diameter / 2.0, diameter / 2.0 + initials.baseline() * size);
    place.scale(size / kOutlineSize, size / kOutlineSize);
    image->white_ = place.map(outline.path);
    return image;
}

std::shared_ptr<AvatarImage> AvatarImage::photo(double diameter, const QImage& picture) {
    if (picture.isNull()) {
        return blank(diameter);
    }
    auto image = std::shared_ptr<AvatarImage>(new AvatarImage(diameter));
    // The largest square around the middle.
    const int side = std::min(picture.width(), picture.height());
    image->photo_ = picture.copy((picture.width() - side) / 2, (picture.height() - side) / 2, side, side);
    return image;
}

std::shared_ptr<AvatarImage> AvatarImage::blank(double diameter) {
    auto image = std::shared_ptr<AvatarImage>(new AvatarImage(diameter));
    image->color_ = PersonColors::stone();
    QTransform scale;
    scale.scale(diameter / kFigure, diameter / kFigure);
    image->white_ = scale.map(figure());
    return image;
}

QImage AvatarImage::cutToCircle(int pixels) const {
    if (cut_.width() == pixels) {
        return cut_;
    }
    QImage scaled = photo_.scaled(pixels, pixels, Qt::IgnoreAspectRatio, Qt::SmoothTransformation);
    QImage cut(pixels, pixels, QImage::Format_ARGB32_Premultiplied);
    cut.fill(Qt::transparent);
    QPainter painter(&cut);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(Qt::NoPen);
    painter.setBrush(QBrush(scaled));
    painter.drawEllipse(QRectF(0, 0, pixels, pixels));
    painter.end();
    cut_ = cut;
    return cut_;
}

void AvatarImage::draw(QPainter& painter, const QRectF& rect, const Palette& /*palette*/) const {
    if (diameter_ <= 0.0 || rect.isEmpty()) {
        return;
    }
    painter.save();
    if (isPhoto()) {
        constexpr int kMostPixels = 2048;
        const double wanted = std::round(rect.width() * pixelsPerUnit(painter));
        painter.setRenderHint(QPainter::SmoothPixmapTransform);
        painter.drawImage(rect, cutToCircle(static_cast<int>(std::clamp(wanted, 1.0, double{kMostPixels}))));
    } else {
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setPen(Qt::NoPen);
        painter.setBrush(color_);
        painter.drawEllipse(rect);
        painter.translate(rect.topLeft());
        painter.scale(rect.width() / diameter_, rect.height() / diameter_);
        painter.fillPath(white_, Qt::white);
    }
    painter.restore();
}

}  // namespace ktr::linux_
