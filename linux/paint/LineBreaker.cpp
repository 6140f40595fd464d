#include "linux/paint/LineBreaker.h"

#include <QFontMetricsF>
#include <QGlyphRun>
#include <QRawFont>
#include <QTextBoundaryFinder>
#include <algorithm>
#include <cmath>

#include "linux/paint/JapanesePhrases.h"

// The shaper's unit is a 64th of a pixel, so that lengths beyond some hundred thousand points would overflow when they
// are added up; no line is wider than kWidest, and no picture either.

namespace ktr::linux_ {

using platform::Rect;
using platform::TextAlignment;

namespace {

constexpr double kWidest = 32000.0;
/// What a width may fall short of a measured one and still hold it.
constexpr double kFit = 0.01;
/// Narrower than nearly all letters are, as a part of the size: what is shaped ahead is then seldom too little.
constexpr double kNarrowLetter = 0.2;
constexpr qsizetype kShapedAhead = 64;

/// Qt reads a word to its end for each line that it breaks it into: a word of a hundred thousand letters would take
/// seconds. No language has longer words; the text that has one breaks anywhere.
bool hasEndlessWord(const QString& text) {
    constexpr qsizetype kLongest = 1000;
    constexpr char16_t kFirstIdeographic = 0x2E80;
    qsizetype length = 0;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const QChar c = text[i];
        const bool isIdeographic = c.unicode() >= kFirstIdeographic && !c.isSurrogate();
        const bool begins = c.isSpace() || (isIdeographic && !JapanesePhrases::isBoundToBefore(text, i));
        length = begins ? 0 : length + 1;
        if (length > kLongest) {
            return true;
        }
    }
    return false;
}

double finite(double value) {
    return std::isfinite(value) ? value : 0.0;
}

}  // namespace

LineBreaker::LineBreaker(const PreparedText& text, const platform::TextContainer& container, const FontChoice& fonts)
    : text_(text),
      letters_(text.text),
      container_(container),
      stretches_(fonts.stretches(text.text)),
      endless_(!(container.width < kWidest)),
      width_(endless_ ? kWidest : std::max(0.0, container.width)) {
    const double size = std::clamp(finite(text.runs.front().font.size), 1.0, 1000.0);
    scale_ = size / std::max(1.0, std::round(size));
}

int LineBreaker::pixelSize(const platform::Font& font) const {
    return static_cast<int>(std::clamp(std::round(finite(font.size) / scale_), 1.0, 1000.0));
}

BrokenText LineBreaker::run() {
    return container_.maximumLines == 1 ? runOneLine() : runLines();
}

qsizetype LineBreaker::wholeCharacter(qsizetype position) const {
    if (position >= letters_.size()) {
        return letters_.size();
    }
    return position > 0 && letters_[position].isLowSurrogate() ? position + 1 : position;
}

qsizetype LineBreaker::unitsFor(double points) const {
    double smallest = 1000.0;
    for (const auto& run : text_.runs) {
        smallest = std::min(smallest, static_cast<double>(pixelSize(run.font)) * scale_);
    }
    const double units = points / (smallest * kNarrowLetter);
    return wholeCharacter(static_cast<qsizetype>(std::min(units, 1e9)) + kShapedAhead);
}

qsizetype LineBreaker::lineEndFrom(qsizetype from) const {
    const qsizetype end = letters_.indexOf(QChar(QChar::LineSeparator), from);
    return end < 0 ? letters_.size() : end;
}

ShapeRecipe LineBreaker::recipe(qsizetype from, qsizetype to, const QString& tail, bool wrap) const {
    ShapeRecipe made;
    made.text = letters_.mid(from, to - from) + tail;
    made.wrap = wrap;
    made.wrapAnywhere = wrap && hasEndlessWord(made.text);
    const auto& first = text_.runAt(from);
    const bool isNatural = first.paragraph.writingDirection == platform::WritingDirection::Natural;
    const bool isRightToLeft = isNatural ? text_.isRightToLeft(from, to, container_.rightToLeft)
                                         : first.paragraph.writingDirection == platform::WritingDirection::RightToLeft;
    made.direction = isRightToLeft ? Qt::RightToLeft : Qt::LeftToRight;
    made.font = FontChoice::spec(first.font, pixelSize(first.font), FontChoice::baseFamily());
    // Each run is set in the families of its scripts; what the layout's own font sets needs no range.
    auto stretch = std::partition_point(stretches_.begin(), stretches_.end(),
                                        [from](const auto& s) { return s.start + s.length <= from; });
    for (const auto& run : text_.runs) {
        const qsizetype runEnd = std::min(run.start + run.length, to);
        for (; stretch != stretches_.end() && stretch->start < runEnd; ++stretch) {
            const qsizetype begin = std::max({stretch->start, run.start, from});
            const qsizetype end = std::min(stretch->start + stretch->length, runEnd);
            const FontSpec font = FontChoice::spec(run.font, pixelSize(run.font), stretch->family);
            if (begin < end && !(font == made.font)) {
                made.ranges.push_back({begin - from, end - begin, font});
            }
            if (stretch->start + stretch->length > runEnd) {
                break;  // the next run goes on in it
            }
        }
    }
    if (!tail.isEmpty() && to > from) {
        const auto& last = text_.runAt(to - 1);
        made.ranges.push_back(
            {to - from, tail.size(), FontChoice::spec(last.font, pixelSize(last.font), FontChoice::baseFamily())});
    }
    appendKeycaps(made);
    return made;
}

void LineBreaker::appendKeycaps(ShapeRecipe& recipe) {
    // A keycap is a digit with marks behind it: the text fonts would take the digit and leave an empty key.
    constexpr char16_t kKeycap = 0x20E3;
    constexpr char16_t kEmojiStyle = 0xFE0F;
    const QString& text = recipe.text;
    for (qsizetype at = text.indexOf(QChar(kKeycap)); at > 0; at = text.indexOf(QChar(kKeycap), at + 1)) {
        const qsizetype start = at - (at > 1 && text[at - 1].unicode() == kEmojiStyle ? 2 : 1);
        FontSpec keys = recipe.font;
        keys.family = FontChoice::emojiFamily();
        recipe.ranges.push_back({start, at - start + 1, keys});
    }
}

BrokenText::Piece LineBreaker::piece(Shaped shaped, qsizetype from, int lines) const {
    const qsizetype to = from + shaped.recipe.text.size();
    std::vector<BrokenText::ColorRange> colors;
    bool colored = false;
    for (const auto& run : text_.runs) {
        const qsizetype begin = std::max(run.start, from);
        const qsizetype end = std::min(run.start + run.length, to);
        if (begin < end) {
            colors.push_back({static_cast<int>(begin - from), static_cast<int>(end - begin), run.color});
            colored = colored || run.color.has_value();
        }
    }
    if (!colored) {
        colors.clear();
    } else if (!colors.empty()) {
        // An ellipsis takes the colour of what it stands for.
        colors.back().length = static_cast<int>(to - from) - colors.back().start;
    }
    return {std::move(shaped.recipe), std::move(shaped.layout), lines, std::move(colors)};
}

LineBreaker::Metrics LineBreaker::metricsOf(qsizetype from, qsizetype to) const {
    // The empty line behind a line end is the last run's.
    from = std::min(from, letters_.size() - 1);
    Metrics metrics;
    for (const auto& run : text_.runs) {
        const bool touches = run.start < std::max(to, from + 1) && run.start + run.length > from;
        if (touches && run.font.lineHeight() > metrics.height) {
            metrics = {run.font.lineHeight(), run.font.ascent()};
        }
    }
    return metrics;
}

LineBreaker::Span LineBreaker::spanAt(double y, double height) const {
    double left = 0.0;
    double right = width_;
    std::optional<double> below;
    for (const Rect& hole : container_.exclusionPaths) {
        if (hole.y >= y + height || hole.maxY() <= y || hole.maxX() <= left || hole.x >= right) {
            continue;
        }
        // The wider side of the hole stays; of two alike the leading one.
        const double before = hole.x - left;
        const double after = right - hole.maxX();
        const bool keepBefore = before > after || (before == after && !container_.rightToLeft);
        if (keepBefore) {
            right = hole.x;
        } else {
            left = hole.maxX();
        }
        below = below ? std::min(*below, hole.maxY()) : hole.maxY();
    }
    const double padding = container_.lineFragmentPadding;
    return {left + padding, std::max(0.0, right - left - 2.0 * padding), below};
}

double LineBreaker::alignedX(const Placed& line, double lineEnd) const {
    TextAlignment alignment = text_.runAt(line.start).paragraph.alignment;
    if (alignment == TextAlignment::Natural) {
        alignment = container_.alignment;
    }
    if (alignment == TextAlignment::Natural) {
        alignment = container_.rightToLeft ? TextAlignment::Right : TextAlignment::Left;
    }
    // A container without an end is as wide as its widest line.
    const double room = endless_ ? lineEnd - line.span.x : line.span.width;
    const double free = std::max(0.0, room - line.width);
    switch (alignment) {
        case TextAlignment::Right:
            return line.span.x + free;
        case TextAlignment::Center:
            return line.span.x + free / 2.0;
        case TextAlignment::Natural:
        case TextAlignment::Left:
            break;
    }
    return line.span.x;
}

std::pair<double, double> LineBreaker::overhang(const QTextLine& line, const Metrics& metrics) const {
    double above = 0.0;
    double below = 0.0;
    for (const QGlyphRun& run : line.glyphRuns()) {
        const QRawFont font = run.rawFont();
        const auto glyphs = run.glyphIndexes();
        const auto positions = run.positions();
        const double baseline = line.y() + line.ascent();
        for (qsizetype i = 0; i < glyphs.size(); ++i) {
            const QRectF ink = font.boundingRect(glyphs[i]).translated(0.0, positions[i].y() - baseline);
            above = std::max(above, -ink.top() * scale_ - metrics.ascent);
            below = std::max(below, ink.bottom() * scale_ - (metrics.height - metrics.ascent));
        }
    }
    return {std::ceil(above - kFit), std::ceil(below - kFit)};
}

bool LineBreaker::breaksAWordThatFits(QTextLine& line, const Span& span) const {
    const qsizetype end = line.textStart() + line.textLength();
    QTextBoundaryFinder words(QTextBoundaryFinder::Line, letters_);
    words.setPosition(end);
    if (end >= letters_.size() || words.isAtBoundary()) {
        return false;
    }
    const qsizetype next = words.toNextBoundary();
    fill(line, width_ - 2.0 * container_.lineFragmentPadding);
    const bool fits = line.textStart() + line.textLength() >= (next < 0 ? letters_.size() : next);
    fill(line, span.width);
    return fits;
}

void LineBreaker::fill(QTextLine& line, double room) const {
    // What may not begin a line takes the letter before it along; a line of nothing else is left as it is.
    constexpr int kMost = 8;
    const double whole = (room + kFit) / scale_;
    line.setLineWidth(whole);
    for (int round = 0; JapanesePhrases::isBoundToBefore(letters_, line.textStart() + line.textLength()); ++round) {
        const int length = line.textLength();
        line.setLineWidth(line.naturalTextWidth() - kFit / scale_);
        if (line.textLength() >= length || round == kMost) {
            line.setLineWidth(whole);
            return;
        }
    }
}

void LineBreaker::placeLine(QTextLine& line, double& y, bool grow, Placed& placed) const {
    Metrics metrics = metricsOf(line.textStart(), line.textStart() + 1);
    // Each round either keeps the line or moves it below an exclusion or makes it higher, so that few are needed.
    for (std::size_t round = 0; round <= container_.exclusionPaths.size() * 2 + 2; ++round) {
        const Span span = spanAt(y, metrics.height);
        fill(line, span.width);
        const double width = line.naturalTextWidth() * scale_;
        placed = {span, width, y, metrics, line.textStart(), line.textLength()};
        if (span.below && (width > span.width + kFit || breaksAWordThatFits(line, span))) {
            y = *span.below;
            continue;
        }
        Metrics needed = metricsOf(line.textStart(), line.textStart() + line.textLength());
        if (grow) {
            const auto [above, below] = overhang(line, needed);
            needed.ascent += std::max(0.0, above);
            needed.height += std::max(0.0, above) + std::max(0.0, below);
        }
        if (needed.height <= metrics.height) {
            placed.metrics = needed;
            break;
        }
        metrics = needed;
        placed.metrics = needed;
    }
    line.setPosition(QPointF(0.0, (y + placed.metrics.ascent) / scale_ - line.ascent()));
    y += placed.metrics.height;
}

LineBreaker::Broken LineBreaker::breakLines(qsizetype shaped, bool grow) const {
    Broken broken;
    broken.shaped.recipe = recipe(0, shaped, {}, true);
    broken.shaped.layout = broken.shaped.recipe.layout();
    QTextLayout* const layout = broken.shaped.layout.get();
    layout->beginLayout();
    double y = 0.0;
    for (;;) {
        QTextLine line = layout->createLine();
        if (!line.isValid()) {
            break;
        }
        if (container_.maximumLines > 0 && static_cast<int>(broken.lines.size()) == container_.maximumLines) {
            line.setLineWidth(1.0);
            broken.overflows = true;
            break;
        }
        Placed placed;
        placeLine(line, y, grow, placed);
        // Only another script's font is taller than the box: what the base font sets needs no look at its glyphs.
        const double below = placed.metrics.height - placed.metrics.ascent;
        broken.tall = broken.tall || line.ascent() * scale_ > placed.metrics.ascent + 1.0 + kFit ||
                      line.descent() * scale_ > below + 1.0 + kFit;
        broken.lines.push_back(placed);
    }
    layout->endLayout();
    return broken;
}

bool LineBreaker::loosen(const Broken& broken) {
    constexpr QChar kWordJoiner(0x2060);
    bool loosened = false;
    for (const Placed& line : broken.lines) {
        const qsizetype end = line.start + line.length;
        if (end > 0 && end < letters_.size() && (letters_[end] == kWordJoiner || letters_[end - 1] == kWordJoiner)) {
            loosened = JapanesePhrases::loosen(letters_, end) || loosened;
        }
    }
    return loosened;
}

BrokenText LineBreaker::runLines() {
    const qsizetype whole = letters_.size();
    qsizetype shaped = whole;
    if (container_.maximumLines > 0) {
        shaped = std::min(whole, unitsFor(width_ * (container_.maximumLines + 1)));
    }
    for (;;) {
        Broken broken = breakLines(shaped, false);
        if (!broken.overflows && shaped < whole) {
            shaped = wholeCharacter(std::min(whole, shaped * 2));
            continue;
        }
        if (loosen(broken)) {
            continue;
        }
        if (broken.lines.size() > 1 && broken.tall) {
            broken = breakLines(shaped, true);
        }
        return finish(std::move(broken));
    }
}

BrokenText LineBreaker::finish(Broken broken) {
    Placed& last = broken.lines.back();
    Shaped tail;
    if (broken.overflows) {
        tail = cutLine(last.start, lineEndFrom(last.start), last.span.width);
        last.width = tail.width;
    }
    double end = 0.0;
    for (const Placed& line : broken.lines) {
        end = std::max(end, line.span.x + line.width);
    }
    BrokenText done;
    done.scale = scale_;
    done.isTruncated = broken.overflows;
    auto& lines = done.lines;
    for (std::size_t i = 0; i < broken.lines.size(); ++i) {
        const Placed& line = broken.lines[i];
        lines.push_back({{alignedX(line, end), line.y, line.width, line.metrics.height}, line.y + line.metrics.ascent});
        QTextLine shaped = broken.shaped.layout->lineAt(static_cast<int>(i));
        shaped.setPosition(QPointF(lines.back().box.x / scale_, shaped.y()));
    }
    const int kept = static_cast<int>(broken.lines.size()) - (broken.overflows ? 1 : 0);
    if (kept > 0) {
        done.pieces.push_back(piece(std::move(broken.shaped), 0, kept));
    }
    if (tail.layout) {
        QTextLine line = tail.layout->lineAt(0);
        line.setPosition(QPointF(lines.back().box.x / scale_, lines.back().baseline / scale_ - line.ascent()));
        done.pieces.push_back(piece(std::move(tail), last.start, 1));
    }
    return done;
}

BrokenText LineBreaker::runOneLine() {
    const qsizetype whole = letters_.size();
    const qsizetype end = lineEndFrom(0);
    double y = 0.0;
    Metrics metrics = metricsOf(0, end);
    Span span = spanAt(y, metrics.height);
    while (span.width <= 0.0 && span.below) {
        y = *span.below;
        span = spanAt(y, metrics.height);
    }
    qsizetype ahead = std::min(end, unitsFor(span.width));
    Shaped shaped = shapeLine(0, ahead, {});
    while (shaped.width <= span.width + kFit && ahead < end) {
        ahead = std::min(end, wholeCharacter(ahead * 2));
        shaped = shapeLine(0, ahead, {});
    }
    const bool overflows = shaped.width > span.width + kFit || end < whole;
    if (overflows) {
        shaped = cutLine(0, end, span.width);
    }
    const double width = shaped.width;
    const Placed placed = {span, width, y, metrics, 0, end};
    const double x = alignedX(placed, span.x + width);
    BrokenText done;
    done.scale = scale_;
    done.isTruncated = overflows;
    if (shaped.layout) {
        QTextLine line = shaped.layout->lineAt(0);
        line.setPosition(QPointF(x / scale_, (y + metrics.ascent) / scale_ - line.ascent()));
        done.pieces.push_back(piece(std::move(shaped), 0, 1));
    }
    done.lines = {{{x, y, width, metrics.height}, y + metrics.ascent}};
    return done;
}

LineBreaker::Shaped LineBreaker::shapeLine(qsizetype from, qsizetype to, const QString& tail) const {
    Shaped shaped;
    shaped.recipe = recipe(from, to, tail, false);
    shaped.layout = shaped.recipe.layout({{kWidest * 2.0, QPointF()}});
    shaped.width = shaped.layout->lineAt(0).naturalTextWidth() * scale_;
    return shaped;
}

LineBreaker::Shaped LineBreaker::cutLine(qsizetype from, qsizetype to, double room) const {
    const qsizetype ahead = std::min(to, wholeCharacter(from + unitsFor(room)));
    // Where the text may be cut: between graphemes, longest first piece last.
    std::vector<qsizetype> cuts = {from};
    const QString piece = letters_.mid(from, ahead - from);
    QTextBoundaryFinder finder(QTextBoundaryFinder::Grapheme, piece);
    for (qsizetype at = finder.toNextBoundary(); at > 0; at = finder.toNextBoundary()) {
        cuts.push_back(from + at);
    }
    Shaped best;
    const auto fits = [&](std::size_t index) {
        qsizetype end = cuts[index];
        while (end > from && letters_[end - 1].isSpace()) {
            --end;
        }
        Shaped cut = shapeLine(from, end, text_.ellipsisAfter(from, end));
        if (cut.width > room + kFit) {
            return false;
        }
        best = std::move(cut);
        return true;
    };
    // Invariant: what is cut at `low` fits, what is cut at `high` does not (or is beyond the text). That the ellipsis
    // alone fits is not known before the end.
    std::size_t low = 0;
    std::size_t high = cuts.size();
    std::size_t probe = estimateCut(cuts, from, ahead, room);
    std::size_t step = 1;
    while (high - low > 1) {
        probe = std::clamp(probe, low + 1, high - 1);
        if (fits(probe)) {
            low = probe;
            probe += step;
        } else {
            high = probe;
            probe -= std::min(probe, step);
        }
        step *= 2;
    }
    if (low == 0) {
        fits(0);
    }
    return best;
}

std::size_t LineBreaker::estimateCut(const std::vector<qsizetype>& cuts, qsizetype from, qsizetype to,
                                     double room) const {
    const Shaped shaped = shapeLine(from, to, QString(QChar(0x2026)));
    const QTextLine line = shaped.layout->lineAt(0);
    const double all = shaped.width;
    const double ellipsis =
        std::abs(line.cursorToX(static_cast<int>(to - from)) - line.cursorToX(static_cast<int>(to - from + 1))) *
        scale_;
    if (all <= 0.0) {
        return cuts.size() - 1;
    }
    const bool rightToLeft = shaped.recipe.direction == Qt::RightToLeft;
    const double edge = (rightToLeft ? all - (room - ellipsis) : room - ellipsis) / scale_;
    const qsizetype at = from + line.xToCursor(edge, QTextLine::CursorBetweenCharacters);
    const auto found = std::upper_bound(cuts.begin(), cuts.end(), at);
    return static_cast<std::size_t>(found - cuts.begin()) - (found == cuts.begin() ? 0 : 1);
}

}  // namespace ktr::linux_
