#include "linux/ui/ShapedText.h"

#include <QCoreApplication>
#include <QGlyphRun>
#include <QPaintEngine>
#include <QPainter>
#include <QThread>
#include <QTransform>
#include <QVarLengthArray>
#include <algorithm>

namespace ktr::linux_ {

namespace {

bool onMainThread() {
    const auto* application = QCoreApplication::instance();
    return application != nullptr && QThread::currentThread() == application->thread();
}

}  // namespace

ShapedText::ShapedText(ShapeRecipe recipe, std::vector<ShapeRecipe::Line> lines, double scale,
                       std::vector<ColorRange> colors, const QTextLayout& layout)
    : recipe_(std::move(recipe)), lines_(std::move(lines)), scale_(scale), colors_(std::move(colors)) {
    recipe_.text.squeeze();
    lines_.shrink_to_fit();
    if (onMainThread()) {
        glyphs_ = glyphsOf(layout);
    }
}

ShapedText::~ShapedText() {
    // The main thread's fonts go where they came from.
    if (glyphs_ && !onMainThread() && QCoreApplication::instance() != nullptr) {
        QMetaObject::invokeMethod(
            QCoreApplication::instance(), [keep = std::move(glyphs_)] {}, Qt::QueuedConnection);
    }
}

std::shared_ptr<const ShapedText::Glyphs> ShapedText::glyphsOf(const QTextLayout& layout) const {
    auto glyphs = std::make_shared<Glyphs>();
    const auto append = [&](const QGlyphRun& run, int color) {
        const auto indexes = run.glyphIndexes();
        const auto positions = run.positions();
        glyphs->runs.push_back({run.rawFont(), static_cast<int>(indexes.size()), color});
        glyphs->indexes.insert(glyphs->indexes.end(), indexes.begin(), indexes.end());
        for (const QPointF& position : positions) {
            // A line is at most 32,000 points wide: a float holds every 64th of a pixel of it.
            glyphs->positions.emplace_back(static_cast<float>(position.x()), static_cast<float>(position.y()));
        }
    };
    for (int i = 0; i < static_cast<int>(lines_.size()); ++i) {
        const QTextLine line = layout.lineAt(i);
        if (colors_.empty()) {
            for (const QGlyphRun& run : line.glyphRuns()) {
                append(run, -1);
            }
            continue;
        }
        const int end = line.textStart() + line.textLength();
        for (int color = 0; color < static_cast<int>(colors_.size()); ++color) {
            const ColorRange& range = colors_[static_cast<std::size_t>(color)];
            const int from = std::max(range.start, line.textStart());
            const int to = std::min(range.start + range.length, end);
            for (const QGlyphRun& run : from < to ? line.glyphRuns(from, to - from) : QList<QGlyphRun>()) {
                append(run, color);
            }
        }
    }
    glyphs->runs.shrink_to_fit();
    glyphs->indexes.shrink_to_fit();
    glyphs->positions.shrink_to_fit();
    return glyphs;
}

void ShapedText::drawGlyphs(QPainter& painter, const QColor& color, const Palette& palette) const {
    QVarLengthArray<QPointF, 128> positions;
    for (const auto& [x, y] : glyphs_->positions) {
        positions.append(QPointF(x, y));
    }
    QGlyphRun run;
    qsizetype begin = 0;
    for (const GlyphRun& part : glyphs_->runs) {
        const ColorRange* range = part.color < 0 ? nullptr : &colors_[static_cast<std::size_t>(part.color)];
        painter.setPen(range != nullptr && range->color ? palette.resolve(*range->color) : color);
        run.setRawFont(part.font);
        run.setRawData(glyphs_->indexes.data() + begin, positions.constData() + begin, part.count);
        painter.drawGlyphRun(QPointF(0, 0), run);
        begin += part.count;
    }
}

void ShapedText::drawLines(QPainter& painter, const QTextLayout& layout, const QColor& color,
                           const Palette& palette) const {
    for (int i = 0; i < static_cast<int>(lines_.size()); ++i) {
        const QTextLine line = layout.lineAt(i);
        painter.setPen(color);
        if (colors_.empty()) {
            line.draw(&painter, QPointF(0, 0));
            continue;
        }
        const int end = line.textStart() + line.textLength();
        for (const ColorRange& range : colors_) {
            const int from = std::max(range.start, line.textStart());
            const int to = std::min(range.start + range.length, end);
            painter.setPen(range.color ? palette.resolve(*range.color) : color);
            for (const QGlyphRun& run : from < to ? line.glyphRuns(from, to - from) : QList<QGlyphRun>()) {
                painter.drawGlyphRun(QPointF(0, 0), run);
            }
        }
    }
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
    if (onMainThread() && engine != nullptr && engine->type() == QPaintEngine::Raster) {
        if (!glyphs_) {
            glyphs_ = glyphsOf(*recipe_.layout(lines_));
        }
        drawGlyphs(painter, color, palette);
    } else {
        const QPainter::RenderHints hints = painter.renderHints();
        painter.setRenderHint(QPainter::TextAntialiasing);
        drawLines(painter, *recipe_.layout(lines_), color, palette);
        painter.setRenderHint(QPainter::TextAntialiasing, hints.testFlag(QPainter::TextAntialiasing));
    }
    painter.setTransform(before);
    painter.setPen(pen);
}

QPainterPath ShapedText::outline() const {
    const auto layout = recipe_.layout(lines_);
    QPainterPath path;
    for (int i = 0; i < static_cast<int>(lines_.size()); ++i) {
        for (const QGlyphRun& run : layout->lineAt(i).glyphRuns()) {
            const QRawFont font = run.rawFont();
            const auto indexes = run.glyphIndexes();
            const auto positions = run.positions();
            for (qsizetype k = 0; k < indexes.size(); ++k) {
                path.addPath(font.pathForGlyph(indexes[k]).translated(positions[k]));
            }
        }
    }
    path.setFillRule(Qt::WindingFill);
    return QTransform::fromScale(scale_, scale_).map(path);
}

}  // namespace ktr::linux_
