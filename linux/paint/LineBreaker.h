#pragma once

#include <QTextLayout>
#include <memory>
#include <optional>
#include <vector>

#include "linux/paint/BrokenText.h"
#include "linux/paint/FontChoice.h"
#include "linux/paint/PreparedText.h"
#include "linux/paint/ShapeRecipe.h"
#include "platform/text/TextEngine.h"

namespace ktr::linux_ {

/// Sets one text in one container: shapes, breaks into lines, places them around exclusions, cuts the tail. Used once.
/// Any thread, while a QGuiApplication exists.
class LineBreaker {
  public:
    /// Text and container must outlive the breaker. The text must not be empty.
    LineBreaker(const PreparedText& text, const platform::TextContainer& container, const FontChoice& fonts);

    BrokenText run();

  private:
    /// A stretch of a line that is free of exclusions. Points.
    struct Span {
        double x = 0.0;
        double width = 0.0;
        /// Where the nearest exclusion that narrows it ends; none without one.
        std::optional<double> below;
    };
    /// How a line stands around its baseline. Points.
    struct Metrics {
        double height = 0.0;
        double ascent = 0.0;
    };
    struct Placed {
        Span span;
        double width = 0.0;
        double y = 0.0;
        Metrics metrics;
        qsizetype start = 0;
        qsizetype length = 0;
    };
    /// A text that this thread has shaped; without a layout there is nothing to draw.
    struct Shaped {
        ShapeRecipe recipe;
        std::unique_ptr<QTextLayout> layout;
        /// Of a single line, points.
        double width = 0.0;
    };
    /// Lines that were broken from the text's first `shaped` units.
    struct Broken {
        Shaped shaped;
        std::vector<Placed> lines;
        bool overflows = false;
        /// Some line holds a font that is higher than the line's box.
        bool tall = false;
    };

    BrokenText runOneLine();
    BrokenText runLines();
    Broken breakLines(qsizetype shaped, bool grow) const;
    void placeLine(QTextLine& line, double& y, bool grow, Placed& placed) const;
    /// Whether a phrase that no line holds may be broken between its words now, so that it is worth breaking again.
    bool loosen(const Broken& broken);
    /// Sets the line in this room, points.
    void fill(QTextLine& line, double room) const;
    BrokenText finish(Broken broken);

    /// How [from, to) with `tail` after it is shaped.
    ShapeRecipe recipe(qsizetype from, qsizetype to, const QString& tail, bool wrap) const;
    static void appendKeycaps(ShapeRecipe& recipe);
    Shaped shapeLine(qsizetype from, qsizetype to, const QString& tail) const;
    /// Keeps the first lines for drawing; the text begins at `from`.
    BrokenText::Piece piece(Shaped shaped, qsizetype from, int lines) const;
    /// The line from `from` cut so that it ends in an ellipsis and fits `room` points; none when not even that fits.
    Shaped cutLine(qsizetype from, qsizetype to, double room) const;
    /// The cut that is likely to fit, from one shaping of the uncut text.
    std::size_t estimateCut(const std::vector<qsizetype>& cuts, qsizetype from, qsizetype to, double room) const;

    Span spanAt(double y, double height) const;
    /// The line, set in this span, ends within a word that a line without exclusions would hold.
    bool breaksAWordThatFits(QTextLine& line, const Span& span) const;
    Metrics metricsOf(qsizetype from, qsizetype to) const;
    /// What the glyphs of a line need beyond its box, above and below, in whole points.
    std::pair<double, double> overhang(const QTextLine& line, const Metrics& metrics) const;
    double alignedX(const Placed& line, double lineEnd) const;
    qsizetype lineEndFrom(qsizetype from) const;
    /// How many units are likely to be enough for this many points of text; at a whole character.
    qsizetype unitsFor(double points) const;
    qsizetype wholeCharacter(qsizetype position) const;
    int pixelSize(const platform::Font& font) const;

    const PreparedText& text_;
    /// The text; phrases that no line holds have their words parted in it.
    QString letters_;
    const platform::TextContainer& container_;
    std::vector<FontChoice::Stretch> stretches_;
    bool endless_;
    double width_;
    double scale_;
};

}  // namespace ktr::linux_
