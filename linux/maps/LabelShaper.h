#pragma once

#include <list>
#include <map>
#include <memory>
#include <string>
#include <tuple>
#include <vector>

#include <QPainterPath>
#include <QString>

namespace ktr::linux_ {

/// A name as outlines, at a size of 1 point: the baseline begins at (0, 0). Immutable.
struct LabelGlyphs {
    struct Glyph {
        QPainterPath outline;  ///< from the glyph's own origin
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
    /// `language` (BCP 47) decides the forms of Han characters. Null for a name with nothing to see.
    std::shared_ptr<const LabelGlyphs> shape(const std::string& name, bool isBold, const std::string& language);

  private:
    using Key = std::tuple<std::string, bool, std::string>;
    struct Kept {
        Key key;
        std::shared_ptr<const LabelGlyphs> glyphs;
    };

    std::list<Kept> kept_;  ///< latest used first
    std::map<Key, std::list<Kept>::iterator> byKey_;
    /// Outlines by font and glyph, shared by names.
    std::map<std::pair<QString, quint32>, QPainterPath> outlines_;
};

}  // namespace ktr::linux_
