#include "linux/paint/ShapedText.h"

#include <QCoreApplication>
#include <QGlyphRun>
#include <QPaintEngine>
#include <QPainter>
#include <QThread>
#include <QTransform>
#include <QVarLengthArray>
#include <algorithm>
#include <bit>

#include "linux/paint/LineBreaker.h"
#include "linux/paint/PreparedText.h"

namespace ktr::linux_ {

namespace {

bool onMainThread() {
    const auto* application = QCoreApplication::instance();
    return application != nullptr && QThread::currentThread() == application->thread();
}

/// Qt makes a new object of the same font for each run that it hands out: one serves for all. The main thread's, until
/// the application ends.
QRawFont sharedFont(const QRawFont& font) {
    constexpr std::size_t kMost = 64;
    static std::vector<QRawFont> known = [] {
        qAddPostRoutine([] { known.clear(); });
        return std::vector<QRawFont>();
    }();
    const auto found = std::find(known.begin(), known.end(), font);
    if (found != known.end()) {
        return *found;
    }
    if (known.size() == kMost) {
        known.clear();
    }
    known.push_back(font);
    return font;
}

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

ShapedText::ShapedText(TextKey key, FontChoice fonts, const BrokenText& broken)
    : key_(std::move(key)), fonts_(std::move(fonts)), scale_(broken.scale) {
    if (onMainThread()) {
        glyphs_ = glyphsOf(broken);
    }
}

ShapedText::~ShapedText() {
    // The main thread's fonts go where they came from.
    if (!glyphs_.runs.empty() && !onMainThread() && QCoreApplication::instance() != nullptr) {
        QMetaObject::invokeMethod(
            QCoreApplication::instance(), [keep = std::make_shared<Glyphs>(std::move(glyphs_))] {},
            Qt::QueuedConnection);
    }
}

ShapedText::Glyphs ShapedText::glyphsOf(const BrokenText& broken) {
    Glyphs glyphs;
    QVarLengthArray<quint32, 256> words;
    const auto append = [&](const QGlyphRun& run, int color) {
        const auto indexes = run.glyphIndexes();
        const auto positions = run.positions();
        if (indexes.isEmpty()) {
            return;
        }
        const double y = positions.front().y();
        const bool hasHeights =
            std::any_of(positions.begin(), positions.end(), [y](const QPointF& position) { return position.y() != y; });
        glyphs.runs.push_back({sharedFont(run.rawFont()), static_cast<int>(indexes.size()), static_cast<short>(color),
                               hasHeights, static_cast<float>(y)});
        for (const QPointF& position : positions) {
            words.append(std::bit_cast<quint32>(static_cast<float>(position.x())));
        }
        for (const QPointF& position : hasHeights ? positions : QList<QPointF>()) {
            words.append(std::bit_cast<quint32>(static_cast<float>(position.y())));
        }
        // A font has at most 65,535 glyphs.
        for (qsizetype i = 0; i < indexes.size(); i += 2) {
            words.append(indexes[i] | (i + 1 < indexes.size() ? indexes[i + 1] << 16U : 0U));
        }
    };
    for (const BrokenText::Piece& piece : broken.pieces) {
        const int before = static_cast<int>(glyphs.colors.size());
        for (const auto& range : piece.colors) {
            glyphs.colors.push_back(range.color);
        }
        visitRuns(piece, [&](const QGlyphRun& run, int color) { append(run, color < 0 ? color : before + color); });
    }
    glyphs.runs.shrink_to_fit();
    glyphs.words = std::make_unique<quint32[]>(static_cast<std::size_t>(words.size()));
    std::copy(words.begin(), words.end(), glyphs.words.get());
    return glyphs;
}

BrokenText ShapedText::shapedAgain() const {
    const platform::TextContainer container = key_.container();
    const PreparedText prepared(key_.text(), PreparedText::Options::of(container));
    return LineBreaker(prepared, container, fonts_).run();
}

void ShapedText::drawGlyphs(QPainter& painter, const QColor& color, const Palette& palette) const {
    QVarLengthArray<QPointF, 128> positions;
    QVarLengthArray<quint32, 128> indexes;
    QGlyphRun run;
    const quint32* word = glyphs_.words.get();
    for (const GlyphRun& part : glyphs_.runs) {
        positions.resize(part.count);
        indexes.resize(part.count);
        for (QPointF& position : positions) {
            position = {std::bit_cast<float>(*word++), part.y};
        }
        for (int i = 0; part.hasHeights && i < part.count; ++i) {
            positions[i].setY(std::bit_cast<float>(*word++));
        }
        for (int i = 0; i < part.count; ++i) {
            indexes[i] = i % 2 == 0 ? *word & 0xFFFFU : *word++ >> 16U;
        }
        word += part.count % 2;
        const auto* own = part.color < 0 ? nullptr : &glyphs_.colors[static_cast<std::size_t>(part.color)];
        painter.setPen(own != nullptr && own->has_value() ? palette.resolve(**own) : color);
        run.setRawFont(part.font);
        run.setRawData(indexes.constData(), positions.constData(), part.count);
        painter.drawGlyphRun(QPointF(0, 0), run);
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
        if (glyphs_.runs.empty()) {
            glyphs_ = glyphsOf(shapedAgain());
        }
        drawGlyphs(painter, color, palette);
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
