#pragma once

#include <QRawFont>
#include <QStringView>
#include <array>
#include <memory>
#include <optional>
#include <vector>

#include "linux/paint/FontChoice.h"

struct hb_buffer_t;
struct hb_face_t;
struct hb_font_t;
struct hb_shape_plan_t;

namespace ktr::linux_ {

/// One font at one size as HarfBuzz shapes with it, to the same glyphs at the same places as Qt does: the shapes'
/// widths are asked of Qt, once a glyph. Lengths are in 64ths of a pixel. Main thread.
class WordFont {
  public:
    struct Glyph {
        quint32 index = 0;
        /// From the word's left edge and its baseline, to the right and down.
        int x = 0;
        int y = 0;
    };
    /// A word in the order in which it is drawn, which is that of its letters.
    struct Word {
        std::vector<Glyph> glyphs;
        int advance = 0;
        /// The glyph of the word's last letter.
        quint32 last = 0;
    };

    /// Whether the script's letters are glyphs one by one, or join by their font's rules alone; true for what belongs
    /// to every script.
    static bool isPlain(QChar::Script script);
    /// The font for a plain script; null for others, and where Qt takes another font than that of the family. Kept
    /// until the application ends; valid until then.
    static WordFont* of(const FontSpec& spec, QChar::Script script);

    WordFont(const QRawFont& raw, std::shared_ptr<hb_face_t> face, QChar::Script script);
    ~WordFont();
    WordFont(const WordFont&) = delete;
    WordFont& operator=(const WordFont&) = delete;

    const QRawFont& raw() const { return raw_; }
    /// None where the font lacks a letter, or a letter may take more than its own glyph: marks, joiners, emoji.
    std::optional<Word> shaped(QStringView word, bool rightToLeft);
    /// How far the glyph's ink goes beyond its advance, as Qt counts it for the last one of a line; not negative.
    int overhang(quint32 glyph);

  private:
    static constexpr std::size_t kPage = 256;
    using Page = std::array<int, kPage>;

    using Plan = std::unique_ptr<hb_shape_plan_t, void (*)(hb_shape_plan_t*)>;

    int advance(quint32 glyph);
    /// How the font's rules are gone through for what the buffer is said to hold; made once for each direction.
    hb_shape_plan_t* plan(bool rightToLeft);

    QRawFont raw_;
    QChar::Script script_;
    std::shared_ptr<hb_face_t> face_;
    /// As the font's tables say, and with Qt's advances.
    std::unique_ptr<hb_font_t, void (*)(hb_font_t*)> unrounded_;
    std::unique_ptr<hb_font_t, void (*)(hb_font_t*)> font_;
    std::unique_ptr<hb_buffer_t, void (*)(hb_buffer_t*)> buffer_;
    Plan leftwards_;
    Plan rightwards_;
    std::array<std::unique_ptr<Page>, kPage> advances_;
    std::array<std::unique_ptr<Page>, kPage> overhangs_;
};

}  // namespace ktr::linux_
