#include "linux/paint/LineShaper.h"

#include <unicode/ubidi.h>

#include <QVarLengthArray>
#include <algorithm>

#include "linux/paint/WordFont.h"

namespace ktr::linux_ {

namespace {

constexpr double kUnits = 64.0;  // a pixel
constexpr int kWidest = 32000;   // pixels
/// Larger texts are few, and their fonts are not kept.
constexpr int kLargest = 100;  // pixels
/// What is longer is no label.
constexpr qsizetype kLongest = 400;

bool isBlank(QChar c) {
    return c == u' ' || c == QChar(QChar::Nbsp);
}

/// What changes more than its own place in the line: bidirectional controls, line ends, keycaps' and object marks; and
/// accents of their own, which may stand on a letter of another script.
bool concernsTheLine(QChar c) {
    const char16_t u = c.unicode();
    return (u >= 0x200E && u <= 0x200F) || (u >= 0x2028 && u <= 0x202E) || (u >= 0x2066 && u <= 0x2069) ||
           (u >= 0x0300 && u <= 0x036F) || u == 0x061C || u == 0x20E3 || u == 0xFFFC;
}

/// Whether the text may have letters that are written from the right: it is certain below Hebrew's block.
bool mayRunLeft(QChar c) {
    const char16_t u = c.unicode();
    return u >= 0x0590 && (u < 0x0900 || c.isSurrogate() || (u >= 0xFB1D && u <= 0xFEFF));
}

}  // namespace

/// Puts words behind each other, and glyphs of one font into one run.
class LineShaper::Pen {
  public:
    explicit Pen(double baseline) : baseline_(baseline) {}

    void add(const WordShaper::Word& word) {
        for (const WordShaper::Glyph& glyph : word.glyphs) {
            if (glyph.font != font_) {
                flush();
                font_ = glyph.font;
            }
            indexes_.append(glyph.index);
            positions_.append({(x_ + glyph.x) / kUnits, baseline_ + glyph.y / kUnits});
        }
        x_ += word.advance;
    }
    void advance(int by) { x_ += by; }
    /// Of the text's last letter, wherever it stands.
    void setOverhang(int overhang) { overhang_ = overhang; }
    int width() const { return x_ + overhang_; }
    PlacedGlyphs made() {
        flush();
        return maker_.made();
    }

  private:
    void flush() {
        if (!indexes_.isEmpty()) {
            maker_.add(WordShaper::font(font_), indexes_.constData(), positions_.constData(),
                       static_cast<int>(indexes_.size()));
            indexes_.clear();
            positions_.clear();
        }
    }

    double baseline_;
    int x_ = 0;
    int overhang_ = 0;
    quint16 font_ = 0;
    QVarLengthArray<quint32, 64> indexes_;
    QVarLengthArray<QPointF, 64> positions_;
    PlacedGlyphs::Maker maker_;
};

LineShaper::LineShaper() : bidi_(ubidi_open(), ubidi_close) {}

LineShaper::~LineShaper() = default;

/// False where a mark or a joiner has no letter before it in its word, or a script is not plain.
bool LineShaper::split(QStringView text, const FontChoice& fonts, const platform::Font& font, int pixelSize) {
    segments_.clear();
    // What belongs to every script goes on in the script before it, at the beginning in the one behind it.
    QChar::Script script = QChar::Script_Common;
    for (const FontChoice::Stretch& stretch : fonts.stretches(text)) {
        const FontSpec spec = FontChoice::spec(font, pixelSize, stretch.family);
        const qsizetype end = stretch.start + stretch.length;
        bool isBegun = false;
        for (qsizetype i = stretch.start; i < end; ++i) {
            const qsizetype start = i;
            char32_t c = text[i].unicode();
            if (text[i].isHighSurrogate() && i + 1 < end) {
                c = QChar::surrogateToUcs4(text[i], text[i + 1]);
                ++i;
            }
            const QChar::Script own = QChar::script(c);
            bool isOther = false;
            if (own > QChar::Script_Common && own != script) {
                if (script == QChar::Script_Common) {
                    std::for_each(segments_.begin(), segments_.end(), [own](Segment& s) { s.script = own; });
                    script = own;
                } else if (!QChar::isMark(c)) {
                    script = own;
                    isOther = true;
                }
            }
            const bool blank = isBlank(text[start]);
            if (!isBegun || isOther || blank != isBlank(text[start - 1])) {
                if (QChar::isMark(c) || QChar::category(c) == QChar::Other_Format) {
                    return false;
                }
                segments_.push_back({start, 0, spec, script});
                isBegun = true;
            }
            segments_.back().length = i + 1 - segments_.back().start;
        }
    }
    return std::all_of(segments_.begin(), segments_.end(),
                       [](const Segment& segment) { return WordFont::isPlain(segment.script); });
}

/// The part of the text that runs in one direction, from its left; false where a word cannot be set alone.
bool LineShaper::set(QStringView text, qsizetype from, qsizetype to, bool rightToLeft, Pen& pen) {
    const auto place = [&](const Segment& segment) {
        const qsizetype start = std::max(segment.start, from);
        const qsizetype end = std::min(segment.start + segment.length, to);
        if (start >= end) {
            return true;
        }
        const auto* word = words_.shaped(segment.font, segment.script, text.mid(start, end - start), rightToLeft);
        if (word == nullptr) {
            return false;
        }
        if (isBlank(text[start])) {
            pen.advance(word->advance);
        } else {
            pen.add(*word);
        }
        if (end == text.size()) {
            pen.setOverhang(word->overhang);
        }
        return true;
    };
    return rightToLeft ? std::all_of(segments_.rbegin(), segments_.rend(), place)
                       : std::all_of(segments_.begin(), segments_.end(), place);
}

std::optional<LineShaper::Line> LineShaper::shaped(const PreparedText& prepared, const FontChoice& fonts, int pixelSize,
                                                   bool rightToLeft, double baseline) {
    const QStringView text = prepared.text;
    if (prepared.runs.size() != 1 || text.size() > kLongest || pixelSize > kLargest || isBlank(text.front()) ||
        isBlank(text.back()) || std::any_of(text.begin(), text.end(), concernsTheLine)) {
        return std::nullopt;
    }
    if (!split(text, fonts, prepared.runs.front().font, pixelSize)) {
        return std::nullopt;
    }
    Pen pen(baseline);
    const auto size = static_cast<qsizetype>(text.size());
    bool isSet = true;
    if (!rightToLeft && std::none_of(text.begin(), text.end(), mayRunLeft)) {
        isSet = set(text, 0, size, false, pen);
    } else {
        UErrorCode status = U_ZERO_ERROR;
        ubidi_setPara(bidi_.get(), reinterpret_cast<const UChar*>(text.utf16()), static_cast<int32_t>(size),
                      rightToLeft ? 1 : 0, nullptr, &status);
        const int32_t runs = ubidi_countRuns(bidi_.get(), &status);
        isSet = U_SUCCESS(status);
        for (int32_t i = 0; isSet && i < runs; ++i) {
            int32_t start = 0;
            int32_t length = 0;
            const bool runsLeft = ubidi_getVisualRun(bidi_.get(), i, &start, &length) == UBIDI_RTL;
            isSet = set(text, start, start + length, runsLeft, pen);
        }
    }
    if (!isSet || pen.width() > kWidest * static_cast<int>(kUnits)) {
        return std::nullopt;
    }
    return Line{pen.made(), pen.width() / kUnits};
}

}  // namespace ktr::linux_
