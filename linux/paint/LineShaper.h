#pragma once

#include <memory>
#include <optional>

#include "linux/paint/FontChoice.h"
#include "linux/paint/PlacedGlyphs.h"
#include "linux/paint/PreparedText.h"
#include "linux/paint/WordShaper.h"

struct UBiDi;

namespace ktr::linux_ {

/// Sets a text on one line without an end, as Qt would, out of words that are kept. Main thread, but for its
/// destruction.
class LineShaper {
  public:
    struct Line {
        PlacedGlyphs glyphs;
        /// As QTextLine counts it: with what the last letter's ink goes beyond its advance. Pixels.
        double width = 0.0;
    };

    LineShaper();
    ~LineShaper();

    /// A text in one font; its baseline `baseline` pixels below the origin. None for what only the whole line can tell:
    /// more than one run, line ends, bidirectional controls, keycaps, blanks at an end; for marks without a
    /// letter, letters that their script's font lacks and scripts beyond WordFont::isPlain; for more than 400 units,
    /// and for lines wider than 32,000 or letters larger than 100 pixels.
    std::optional<Line> shaped(const PreparedText& text, const FontChoice& fonts, int pixelSize, bool rightToLeft,
                               double baseline);
    std::size_t shapedWords() const { return words_.shapedCount(); }
    /// Those of them that took Qt's layout.
    std::size_t wordsShapedByQt() const { return words_.shapedByQtCount(); }

  private:
    /// Part of the text in one family, script and direction, blanks or none.
    struct Segment {
        qsizetype start = 0;
        qsizetype length = 0;
        FontSpec font;
        QChar::Script script = QChar::Script_Common;
    };
    class Pen;

    bool split(QStringView text, const FontChoice& fonts, const platform::Font& font, int pixelSize);
    bool set(QStringView text, qsizetype from, qsizetype to, bool rightToLeft, Pen& pen);

    WordShaper words_;
    std::vector<Segment> segments_;
    std::unique_ptr<UBiDi, void (*)(UBiDi*)> bidi_;
};

}  // namespace ktr::linux_
