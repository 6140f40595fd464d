#include "linux/maps/MapText.h"

#include <QGlyphRun>
#include <QPen>
#include <QRawFont>
#include <QTextLayout>
#include <algorithm>

#include "linux/paint/FontChoice.h"

namespace ktr::linux_ {

namespace {

constexpr qsizetype kMostCharacters = 200;
constexpr double kWidestLine = 1e5;

QList<QTextLayout::FormatRange> formatsOf(const QString& text, const QString& language, const MapText::Look& look) {
    QList<QTextLayout::FormatRange> formats;
    for (const FontChoice::Stretch& stretch : FontChoice(language).stretches(text)) {
        const FontSpec spec{stretch.family, look.size, look.isBold ? QFont::Bold : QFont::Normal};
        QTextCharFormat format = spec.format();
        if (look.isItalic) {
            format.setFontItalic(true);
        }
        formats.append({static_cast<int>(stretch.start), static_cast<int>(stretch.length), format});
    }
    return formats;
}

}  // namespace

MapText::MapText(const QString& text, const QString& language, const Look& look) {
    const QString shown = text.left(kMostCharacters).simplified();
    const FontSpec base{FontChoice::baseFamily(), look.size, look.isBold ? QFont::Bold : QFont::Normal};
    QTextLayout layout(shown, base.font());
    layout.setFormats(formatsOf(shown, language, look));
    layout.beginLayout();
    QTextLine line = layout.createLine();
    if (line.isValid()) {
        line.setLineWidth(kWidestLine);
        line.setPosition({0.0, 0.0});
    }
    layout.endLayout();
    if (!line.isValid()) {
        return;
    }
    ascent_ = line.ascent();
    descent_ = line.descent();
    width_ = line.naturalTextWidth();
    const double left = line.naturalTextRect().left();
    outline_.setFillRule(Qt::WindingFill);
    for (const QGlyphRun& run : layout.glyphRuns()) {
        const QRawFont font = run.rawFont();
        const QList<quint32> glyphs = run.glyphIndexes();
        const QList<QPointF> places = run.positions();
        for (qsizetype i = 0; i < std::min(glyphs.size(), places.size()); ++i) {
            outline_.addPath(font.pathForGlyph(glyphs[i]).translated(places[i].x() - left, places[i].y() - ascent_));
        }
    }
}

void MapText::draw(QPainter& painter, QPointF baseline, const QColor& ink, const QColor& halo, double haloWidth) const {
    const QPainterPath placed = outline_.translated(baseline);
    painter.setBrush(Qt::NoBrush);
    painter.setPen(QPen(halo, haloWidth, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    painter.drawPath(placed);
    painter.fillPath(placed, ink);
}

}  // namespace ktr::linux_
