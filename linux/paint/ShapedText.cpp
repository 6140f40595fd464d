#include "linux/paint/ShapedText.h"

#include <QCoreApplication>
#include <QGlyphRun>
#include <QPaintEngine>
#include <QPainter>
#include <QThread>
#include <QTransform>
#include <QVarLengthArray>
#include <algorithm>

#include "linux/paint/LineBreaker.h"
#include "linux/paint/PreparedText.h"

namespace ktr::linux_ {

namespace {

/// The glyph runs of a piece's lines, each with the place of its colour in the piece, or -1.
template <class Visit>
void visitRuns(const BrokenText::Piece& piece, const Visit& visit) {
    for (int i = 0; i < piece.lines; ++i) {
        const QTextLine line = piece.layout->lineAt(i);
        if (piece.colors.empty()) {
            for (const QGlyphRun& run : line.glyphRuns()) {
                visit(run, -1);
            }
            continue;
        }
        const int end = line.textStart() + line.textLength();
        for (int color = 0; color < static_cast<int>(piece.colors.size()); ++color) {
            const auto& range = piece.colors[static_cast<std::size_t>(color)];
            const int from = std::max(range.start, line.textStart());
            const int to = std::min(range.start + range.length, end);
            for (const QGlyphRun& run : from < to ? line.glyphRuns(from, to - from) : QList<QGlyphRun>()) {
                visit(run, color);
            }
        }
    }
}

void drawLines(QPainter& painter, const BrokenText::Piece& piece, const QColor& color, const Palette& palette) {
    if (piece.colors.empty()) {
        painter.setPen(color);
        for (int i = 0; i < piece.lines; ++i) {
            piece.layout->lineAt(i).draw(&painter, QPointF(0, 0));
        }
        return;
    }
    visitRuns(piece, [&](const QGlyphRun& run, int at) {
        const auto& own = piece.colors[static_cast<std::size_t>(at)].color;
        painter.setPen(own ? palette.resolve(*own) : color);
        painter.drawGlyphRun(QPointF(0, 0), run);
    });
}

}  // namespace

bool ShapedText::keepsGlyphsHere() {
    const auto* application = QCoreApplication::instance();
    return application != nullptr && QThread::currentThread() == application->thread();
}

ShapedText::ShapedText(TextKey key, FontChoice fonts, const BrokenText& broken)
    : key_(std::move(key)), fonts_(std::move(fonts)), scale_(broken.scale) {
    if (keepsGlyphsHere()) {
        glyphs_ = glyphsOf(broken);
    }
}

ShapedText::ShapedText(TextKey key, FontChoice fonts, double scale, PlacedGlyphs glyphs)
    : key_(std::move(key)), fonts_(std::move(fonts)), scale_(scale), glyphs_(std::move(glyphs)) {}

ShapedText::~ShapedText() {
    // The main thread's fonts go where they came from.
    if (!glyphs_.empty() && !keepsGlyphsHere() && QCoreApplication::instance() != nullptr) {
        QMetaObject::invokeMethod(
            QCoreApplication::instance(), [keep = std::make_shared<PlacedGlyphs>(std::move(glyphs_))] {},
            Qt::QueuedConnection);
    }
}

PlacedGlyphs ShapedText::glyphsOf(const BrokenText& broken) {
    PlacedGlyphs::Maker maker;
    for (const BrokenText::Piece& piece : broken.pieces) {
        QVarLengthArray<int, 8> colors;
        for (const auto& range : piece.colors) {
            colors.append(maker.addColor(range.color));
        }
        visitRuns(piece, [&](const QGlyphRun& run, int color) {
            const auto indexes = run.glyphIndexes();
            const auto positions = run.positions();
            maker.add(run.rawFont(), indexes.constData(), positions.constData(), static_cast<int>(indexes.size()),
                      color < 0 ? -1 : colors[color]);
        });
    }
    return maker.made();
}

BrokenText ShapedText::shapedAgain() const {
    const platform::TextContainer container = key_.container();
    const PreparedText prepared(key_.text(), PreparedText::Options::of(container));
    return LineBreaker(prepared, container, fonts_).run();
}

void ShapedText::draw(QPainter& painter, QPointF origin, const QColor& color, const Palette& palette) const {
    const QTransform before = painter.transform();
    const QPen pen = painter.pen();
    painter.translate(origin);
    if (scale_ != 1.0) {
        painter.scale(scale_, scale_);
    }
    // Vector pictures hold the text itself, not its glyphs alone.
    const auto* engine = painter.paintEngine();
    if (keepsGlyphsHere() && engine != nullptr && engine->type() == QPaintEngine::Raster) {
        if (glyphs_.empty()) {
            glyphs_ = glyphsOf(shapedAgain());
        }
        glyphs_.draw(painter, color, palette);
    } else {
        const QPainter::RenderHints hints = painter.renderHints();
        painter.setRenderHint(QPainter::TextAntialiasing);
        for (const BrokenText::Piece& piece : shapedAgain().pieces) {
            drawLines(painter, piece, color, palette);
        }
        painter.setRenderHint(QPainter::TextAntialiasing, hints.testFlag(QPainter::TextAntialiasing));
    }
    painter.setTransform(before);
    painter.setPen(pen);
}

QPainterPath ShapedText::outline() const {
    QPainterPath path;
    for (const BrokenText::Piece& piece : shapedAgain().pieces) {
        for (int i = 0; i < piece.lines; ++i) {
            for (const QGlyphRun& run : piece.layout->lineAt(i).glyphRuns()) {
                const QRawFont font = run.rawFont();
                const auto indexes = run.glyphIndexes();
                const auto positions = run.positions();
                for (qsizetype k = 0; k < indexes.size(); ++k) {
                    path.addPath(font.pathForGlyph(indexes[k]).translated(positions[k]));
                }
            }
        }
    }
    path.setFillRule(Qt::WindingFill);
    return QTransform::fromScale(scale_, scale_).map(path);
}

}  // namespace ktr::linux_
