#include "linux/maps/LabelShaper.h"

#include <algorithm>

#include <QGlyphRun>
#include <QRawFont>
#include <QTextLayout>

#include "linux/maps/LabelHalo.h"
#include "linux/paint/FontChoice.h"
#include "linux/paint/OpenedFont.h"
#include "platform/ui/Font.h"

namespace ktr::linux_ {

namespace {

/// Names are shaped once at this size; outlines are scaled.
constexpr int kShapedPixels = 64;
constexpr std::size_t kMostKept = 1500;
constexpr std::size_t kMostLetters = 3000;

/// Whether letters may be set one by one, each turned its own way.
bool standAlone(const QString& text) {
    return std::all_of(text.begin(), text.end(), [](QChar letter) {
        switch (letter.script()) {
            case QChar::Script_Latin:
            case QChar::Script_Greek:
            case QChar::Script_Cyrillic:
            case QChar::Script_Armenian:
            case QChar::Script_Georgian:
            case QChar::Script_Hebrew:
            case QChar::Script_Han:
            case QChar::Script_Hiragana:
            case QChar::Script_Katakana:
            case QChar::Script_Hangul:
            case QChar::Script_Bopomofo:
            case QChar::Script_Common:
            case QChar::Script_Inherited:
                return true;
            default:
                return letter.isSurrogate();
        }
    });
}

/// A path of polygons, in sizes of the letters: curves are made straight once, not in each picture.
QPainterPath pathOf(const QList<QPolygonF>& rings, double unit) {
    QPainterPath path;
    path.setFillRule(Qt::WindingFill);
    for (const QPolygonF& ring : rings) {
        path.addPolygon(QTransform::fromScale(unit, unit).map(ring));
        path.closeSubpath();
    }
    return path;
}

QList<QTextLayout::FormatRange> formats(const QString& text, bool isBold, const std::string& language) {
    const FontChoice choice(QString::fromStdString(language));
    platform::Font font;
    if (isBold) {
        font.weight = platform::FontWeight::Bold;
    }
    QList<QTextLayout::FormatRange> ranges;
    for (const auto& stretch : choice.stretches(text)) {
        QTextLayout::FormatRange range;
        range.start = static_cast<int>(stretch.start);
        range.length = static_cast<int>(stretch.length);
        range.format = FontChoice::spec(font, kShapedPixels, stretch.family).format();
        ranges.append(range);
    }
    return ranges;
}

}  // namespace

bool LabelShaper::add(const QGlyphRun& run, QPointF origin, double haloWidth, LabelGlyphs& made) {
    const double unit = 1.0 / kShapedPixels;
    const QRawFont font = run.rawFont();
    bool hasInk = false;
    const auto indexes = run.glyphIndexes();
    const auto positions = run.positions();
    const auto advances = font.advancesForGlyphIndexes(indexes);
    const QString fontName = font.familyName() + QLatin1Char('/') + font.styleName();
    for (qsizetype index = 0; index < indexes.size(); ++index) {
        auto& letter = letters_[{fontName, indexes[index], haloWidth}];
        if (letter.outline.isEmpty()) {
            const auto rings = font.pathForGlyph(indexes[index]).toSubpathPolygons();
            letter.outline = pathOf(rings, unit);
            letter.halo = pathOf(LabelHalo::around(rings, haloWidth * kShapedPixels / 2.0), unit);
        }
        LabelGlyphs::Glyph glyph;
        glyph.outline = letter.outline;
        glyph.halo = letter.halo;
        glyph.ink = letter.outline.boundingRect();
        glyph.x = (positions[index].x() - origin.x()) * unit;
        glyph.y = (positions[index].y() - origin.y()) * unit;
        glyph.advance = index < advances.size() ? advances[index].x() * unit : 0.0;
        hasInk = hasInk || !glyph.ink.isEmpty();
        made.width = std::max({made.width, glyph.x + glyph.advance, glyph.x + glyph.ink.right()});
        made.ascent = std::max(made.ascent, -(glyph.y + glyph.ink.top()));
        made.descent = std::max(made.descent, glyph.y + glyph.ink.bottom());
        made.glyphs.push_back(std::move(glyph));
    }
    return hasInk;
}

std::shared_ptr<const LabelGlyphs> LabelShaper::shape(const std::string& name, const Style& style) {
    const Key key(name, style);
    if (const auto found = byKey_.find(key); found != byKey_.end()) {
        kept_.splice(kept_.begin(), kept_, found->second);
        return kept_.front().glyphs;
    }
    if (letters_.size() > kMostLetters) {
        letters_.clear();
    }
    const QString text = QString::fromStdString(name).simplified();
    auto made = std::make_shared<LabelGlyphs>();
    QTextLayout layout(text, FontChoice::spec(platform::Font(), kShapedPixels, FontChoice::baseFamily()).font());
    layout.setFormats(formats(text, style.isBold, style.language));
    layout.setCacheEnabled(false);
    layout.beginLayout();
    QTextLine line = layout.createLine();
    if (line.isValid()) {
        line.setLineWidth(1e6);
    }
    layout.endLayout();
    const double left = line.isValid() ? line.naturalTextRect().left() : 0.0;
    const double baseline = line.isValid() ? line.y() + line.ascent() : 0.0;
    bool hasInk = false;
    for (const QGlyphRun& run : layout.glyphRuns()) {
        if (isOpened(run.rawFont())) {
            hasInk = add(run, {left, baseline}, style.haloWidth, *made) || hasInk;
        }
    }
    std::stable_sort(made->glyphs.begin(), made->glyphs.end(), [](const auto& a, const auto& b) { return a.x < b.x; });
    made->isJoined = !standAlone(text);
    kept_.push_front({key, hasInk ? made : nullptr});
    byKey_[key] = kept_.begin();
    if (kept_.size() > kMostKept) {
        byKey_.erase(kept_.back().key);
        kept_.pop_back();
    }
    return kept_.front().glyphs;
}

}  // namespace ktr::linux_
