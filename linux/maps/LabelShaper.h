#pragma once

#include <compare>
#include <list>
#include <map>
#include <memory>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include <QGlyphRun>
#include <QPainterPath>
#include <QPointF>
#include <QRectF>
#include <QString>

namespace ktr::linux_ {

/// A name as outlines, at a size of 1 point: the baseline begins at (0, 0). Immutable.
struct LabelGlyphs {
    struct Glyph {
        QPainterPath outline;  ///< from the glyph's own origin; without curves
        QPainterPath halo;     ///< the outline made wider by half of the halo's width on each side
        QRectF ink;            ///< around the outline
        double x = 0.0;        ///< of the origin
        double y = 0.0;
        double advance = 0.0;
    };
    std::vector<Glyph> glyphs;  ///< from left to right
    double width = 0.0;
    double ascent = 0.0;   ///< of what is written, above the baseline
    double descent = 0.0;  ///< the same below
    /// Letters of a script that joins or stacks them: they stand on one straight line.
    bool isJoined = false;
};

/// Shapes names, in any script. Keeps the latest ones. One thread at a time, while a QGuiApplication exists.
class LabelShaper {
  public:
    /// How a name is shaped. `haloWidth` is in sizes of the letters; `language` (BCP 47) decides the forms of Han
    /// characters.
    struct Style {
        bool isBold = false;
        double haloWidth = 0.0;
        std::string language;
        auto operator<=>(const Style&) const = default;  // NOLINT(modernize-use-nullptr): it has none
    };

    /// Null for a name with nothing to see.
    std::shared_ptr<const LabelGlyphs> shape(const std::string& name, const Style& style);

  private:
    using Key = std::pair<std::string, Style>;
    struct Letter {
        QPainterPath outline, halo;
    };
    struct Kept {
        Key key;
        std::shared_ptr<const LabelGlyphs> glyphs;
    };

    /// Puts a run's letters to a name's, whose line begins at `origin`. Whether there is anything to see of them.
    bool add(const QGlyphRun& run, QPointF origin, double haloWidth, LabelGlyphs& made);

    std::list<Kept> kept_;  ///< latest used first
    std::map<Key, std::list<Kept>::iterator> byKey_;
    /// Letters by font, glyph and width of the halo, shared by names.
    std::map<std::tuple<QString, quint32, double>, Letter> letters_;
};

}  // namespace ktr::linux_
