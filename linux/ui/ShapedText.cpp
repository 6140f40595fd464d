#include "linux/ui/ShapedText.h"

#include <QCoreApplication>
#include <QGlyphRun>
#include <QPainter>
#include <QThread>
#include <algorithm>

namespace ktr::linux_ {

namespace {

bool onMainThread() {
    const auto* application = QCoreApplication::instance();
    return application != nullptr && QThread::currentThread() == application->thread();
}

}  // namespace

ShapedText::ShapedText(ShapeRecipe recipe, std::vector<ShapeRecipe::Line> lines, double scale,
                       std::vector<ColorRange> colors, std::unique_ptr<QTextLayout> layout)
    : recipe_(std::move(recipe)), lines_(std::move(lines)), scale_(scale), colors_(std::move(colors)) {
    if (onMainThread()) {
        layout_ = std::move(layout);
    }
}

ShapedText::~ShapedText() {
    // The main thread's fonts go where they came from.
    if (layout_ && !onMainThread() && QCoreApplication::instance() != nullptr) {
        QMetaObject::invokeMethod(
            QCoreApplication::instance(), [keep = std::move(layout_)] {}, Qt::QueuedConnection);
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
    painter.save();
    painter.translate(origin);
    painter.scale(scale_, scale_);
    painter.setRenderHint(QPainter::TextAntialiasing);
    if (onMainThread()) {
        if (!layout_) {
            layout_ = recipe_.layout(lines_);
        }
        drawLines(painter, *layout_, color, palette);
    } else {
        drawLines(painter, *recipe_.layout(lines_), color, palette);
    }
    painter.restore();
}

}  // namespace ktr::linux_
