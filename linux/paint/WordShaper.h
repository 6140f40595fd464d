#pragma once

#include <QRawFont>
#include <QString>
#include <unordered_map>
#include <vector>

#include "linux/paint/FontChoice.h"

namespace ktr::linux_ {

/// Shapes words for lines that are never broken, and keeps them: names and places are made of the same words again and
/// again, an emoji's picture is looked at once. What is more than letters is shaped by Qt. Lengths are in 64ths of a
/// pixel. Main thread, but for its destruction.
class WordShaper {
  public:
    struct Glyph {
        quint16 index = 0;
        /// Of `font`.
        quint16 font = 0;
        /// From the word's left edge and its baseline, to the right and down.
        int x = 0;
        int y = 0;
    };
    struct Word {
        /// In the order in which they are drawn.
        std::vector<Glyph> glyphs;
        int advance = 0;
        /// What a line that the word's last letter is the last of is wider than its advances.
        int overhang = 0;
        bool isCertain = true;
    };

    /// A word of one family, script and direction; none where more than the word tells which fonts its letters are set
    /// in. Valid until the next call.
    const Word* shaped(const FontSpec& font, QChar::Script script, QStringView word, bool rightToLeft);
    /// How many words were shaped.
    std::size_t shapedCount() const { return shaped_; }
    /// Of these, how many Qt's layout shaped, which takes several times as long.
    std::size_t shapedByQtCount() const { return shapedByQt_; }
    /// A font by its number in a word; valid until the application ends.
    static const QRawFont& font(quint16 number);

  private:
    struct KeyView {
        std::size_t font = 0;
        QStringView text;
    };
    struct Key {
        std::size_t font = 0;
        QString text;
        operator KeyView() const { return {font, text}; }
    };
    struct Hash {
        using is_transparent = void;
        std::size_t operator()(const KeyView& key) const { return qHash(key.text, key.font); }
    };
    struct Equal {
        using is_transparent = void;
        bool operator()(const KeyView& a, const KeyView& b) const { return a.font == b.font && a.text == b.text; }
    };
    static const Word* ifCertain(const Word& word) { return word.isCertain ? &word : nullptr; }
    using Words = std::unordered_map<Key, Word, Hash, Equal>;

    struct Setting {
        FontSpec font;
        QChar::Script script = QChar::Script_Common;
        bool rightToLeft = false;
        bool operator==(const Setting&) const = default;
    };
    std::size_t numberOf(const Setting& setting);
    const Word* keep(Key key, Word word);
    Word shapedOnce(const Setting& setting, QStringView word);
    static Word shapedByQt(const Setting& setting, QStringView word);

    std::vector<Setting> settings_;
    /// Where the last setting stood: lines have few.
    std::size_t lastSetting_ = 0;
    /// What was asked for since the others became the older ones, which are dropped when these are many.
    Words words_;
    Words older_;
    std::size_t shaped_ = 0;
    std::size_t shapedByQt_ = 0;
};

}  // namespace ktr::linux_
