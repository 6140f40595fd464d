#include "linux/paint/WordFont.h"

#include <hb-ot.h>
#include <hb.h>

#include <QCoreApplication>
#include <QGlyphRun>
#include <QTextLayout>
#include <algorithm>
#include <cmath>

#include "linux/paint/OpenedFont.h"

namespace ktr::linux_ {

namespace {

constexpr double kUnits = 64.0;  // a pixel

struct PlainScript {
    QChar::Script script;
    hb_script_t tag;
    /// A letter that a font for the script has.
    char16_t sample;
};

/// Scripts whose letters are glyphs one by one or join by their font's rules alone.
constexpr std::array kPlainScripts = {
    PlainScript{QChar::Script_Common, HB_SCRIPT_COMMON, u'1'},
    PlainScript{QChar::Script_Latin, HB_SCRIPT_LATIN, u'a'},
    PlainScript{QChar::Script_Greek, HB_SCRIPT_GREEK, 0x03B1},
    PlainScript{QChar::Script_Cyrillic, HB_SCRIPT_CYRILLIC, 0x0430},
    PlainScript{QChar::Script_Arabic, HB_SCRIPT_ARABIC, 0x0628},
    PlainScript{QChar::Script_Hebrew, HB_SCRIPT_HEBREW, 0x05D0},
    PlainScript{QChar::Script_Han, HB_SCRIPT_HAN, 0x4E00},
    PlainScript{QChar::Script_Hiragana, HB_SCRIPT_HIRAGANA, 0x3042},
    PlainScript{QChar::Script_Katakana, HB_SCRIPT_KATAKANA, 0x30A2},
    PlainScript{QChar::Script_Hangul, HB_SCRIPT_HANGUL, 0xAC00},
};

const PlainScript* plain(QChar::Script script) {
    const auto* found = std::find_if(kPlainScripts.begin(), kPlainScripts.end(),
                                     [script](const PlainScript& known) { return known.script == script; });
    return found == kPlainScripts.end() ? nullptr : found;
}

bool isALetter(QChar c) {
    return c.isLetterOrNumber() || c.isPunct() || c.isSymbol() || c == u' ' || c == QChar(QChar::Nbsp);
}

hb_blob_t* tableOf(hb_face_t*, hb_tag_t tag, void* font) {
    const std::array<char, 5> name = {static_cast<char>(tag >> 24U), static_cast<char>(tag >> 16U),
                                      static_cast<char>(tag >> 8U), static_cast<char>(tag), '\0'};
    auto table = std::make_unique<QByteArray>(static_cast<const QRawFont*>(font)->fontTable(name.data()));
    const char* bytes = table->constData();
    const auto size = static_cast<unsigned>(table->size());
    return hb_blob_create(bytes, size, HB_MEMORY_MODE_READONLY, table.release(),
                          [](void* made) { delete static_cast<QByteArray*>(made); });
}

/// The font that Qt takes for a letter of the script, an invalid one where that is of another family.
QRawFont fontThatQtTakes(const FontSpec& spec, char16_t sample) {
    QTextLayout layout(QString(QChar(sample)), spec.font());
    layout.beginLayout();
    layout.createLine().setLineWidth(spec.pixelSize * 4.0);
    layout.endLayout();
    const auto runs = layout.lineAt(0).glyphRuns();
    const QRawFont taken = runs.size() == 1 ? runs.front().rawFont() : QRawFont();
    return isOpened(taken) && taken.familyName() == spec.family ? taken : QRawFont();
}

/// The fonts that were asked for, and the files' tables, which do not depend on the size.
struct Fonts {
    struct Font {
        FontSpec spec;
        QChar::Script script;
        std::unique_ptr<WordFont> font;
    };
    struct Face {
        QString family;
        QFont::Weight weight;
        std::shared_ptr<hb_face_t> face;
    };
    std::vector<Font> fonts;
    std::vector<Face> faces;

    std::shared_ptr<hb_face_t> face(const FontSpec& spec, const QRawFont& raw) {
        for (const Face& known : faces) {
            if (known.weight == spec.weight && known.family == spec.family) {
                return known.face;
            }
        }
        hb_face_t* const made = hb_face_create_for_tables(tableOf, new QRawFont(raw),
                                                          [](void* font) { delete static_cast<QRawFont*>(font); });
        return faces.emplace_back(Face{spec.family, spec.weight, {made, hb_face_destroy}}).face;
    }
};

Fonts& knownFonts() {
    static Fonts known = [] {
        qAddPostRoutine([] { known = {}; });
        return Fonts();
    }();
    return known;
}

}  // namespace

bool WordFont::isPlain(QChar::Script script) {
    return plain(script) != nullptr;
}

WordFont* WordFont::of(const FontSpec& spec, QChar::Script script) {
    // Sizes are few: those of the interface's styles. Beyond, Qt shapes.
    constexpr std::size_t kMost = 1000;
    Fonts& known = knownFonts();
    for (const auto& font : known.fonts) {
        if (font.script == script && font.spec == spec) {
            return font.font.get();
        }
    }
    const PlainScript* const plainScript = plain(script);
    if (plainScript == nullptr || known.fonts.size() >= kMost) {
        return nullptr;
    }
    const QRawFont raw = fontThatQtTakes(spec, plainScript->sample);
    auto made = raw.isValid() ? std::make_unique<WordFont>(raw, known.face(spec, raw), script) : nullptr;
    return known.fonts.emplace_back(Fonts::Font{spec, script, std::move(made)}).font.get();
}

WordFont::WordFont(const QRawFont& raw, std::shared_ptr<hb_face_t> face, QChar::Script script)
    : raw_(raw),
      script_(script),
      face_(std::move(face)),
      unrounded_(hb_font_create(face_.get()), hb_font_destroy),
      font_(nullptr, hb_font_destroy),
      buffer_(hb_buffer_create(), hb_buffer_destroy),
      leftwards_(nullptr, hb_shape_plan_destroy),
      rightwards_(nullptr, hb_shape_plan_destroy) {
    // Downwards is positive, as in Qt: the other sign would round the other way.
    const auto pixels = static_cast<unsigned>(raw_.pixelSize());
    const int scale = static_cast<int>(raw_.pixelSize() * kUnits);
    hb_font_set_scale(unrounded_.get(), scale, -scale);
    hb_font_set_ppem(unrounded_.get(), pixels, pixels);
    static const auto kAsksForAdvances = [] {
        std::unique_ptr<hb_font_funcs_t, void (*)(hb_font_funcs_t*)> made(hb_font_funcs_create(),
                                                                          hb_font_funcs_destroy);
        hb_font_funcs_set_glyph_h_advance_func(
            made.get(),
            [](hb_font_t*, void* data, hb_codepoint_t glyph, void*) {
                return static_cast<hb_position_t>(static_cast<WordFont*>(data)->advance(glyph));
            },
            nullptr, nullptr);
        hb_font_funcs_make_immutable(made.get());
        return made;
    }();
    font_.reset(hb_font_create_sub_font(unrounded_.get()));
    hb_font_set_funcs(font_.get(), kAsksForAdvances.get(), this, nullptr);
}

WordFont::~WordFont() = default;

namespace {

/// What is known of a glyph, or asked once.
template <class Pages, class Ask>
int kept(Pages& pages, quint32 glyph, const Ask& ask) {
    constexpr int kUnknown = std::numeric_limits<int>::min();
    auto& page = pages[(glyph / pages.size()) % pages.size()];
    if (!page) {
        page = std::make_unique<typename Pages::value_type::element_type>();
        page->fill(kUnknown);
    }
    int& value = (*page)[glyph % page->size()];
    if (value == kUnknown) {
        value = ask();
    }
    return value;
}

}  // namespace

int WordFont::advance(quint32 glyph) {
    return kept(advances_, glyph, [&] {
        const auto advances = raw_.advancesForGlyphIndexes({glyph});
        return advances.isEmpty() ? 0 : static_cast<int>(std::lround(advances.front().x() * kUnits));
    });
}

int WordFont::overhang(quint32 glyph) {
    return kept(overhangs_, glyph, [&] {
        // Qt's boxes of glyphs are whole pixels, and so is the advance that it holds them against.
        const int whole = (hb_font_get_glyph_h_advance(unrounded_.get(), glyph) + 32) >> 6;
        const QRectF box = raw_.boundingRect(glyph);
        return std::max(0, static_cast<int>(std::lround((box.x() + box.width() - whole) * kUnits)));
    });
}

hb_shape_plan_t* WordFont::plan(bool rightToLeft) {
    Plan& plan = rightToLeft ? leftwards_ : rightwards_;
    if (!plan) {
        hb_segment_properties_t properties;
        hb_buffer_get_segment_properties(buffer_.get(), &properties);
        plan.reset(hb_shape_plan_create_cached(face_.get(), &properties, nullptr, 0, nullptr));
    }
    return plan.get();
}

std::optional<WordFont::Word> WordFont::shaped(QStringView word, bool rightToLeft) {
    // A letter that the font lacks would be put together from others that it has; Qt takes another font.
    if (!std::all_of(word.begin(), word.end(), [this](QChar c) { return isALetter(c) && raw_.supportsCharacter(c); })) {
        return std::nullopt;
    }
    hb_buffer_t* const buffer = buffer_.get();
    hb_buffer_clear_contents(buffer);
    hb_buffer_add_utf16(buffer, reinterpret_cast<const std::uint16_t*>(word.utf16()), static_cast<int>(word.size()), 0,
                        static_cast<int>(word.size()));
    hb_buffer_set_direction(buffer, rightToLeft ? HB_DIRECTION_RTL : HB_DIRECTION_LTR);
    hb_buffer_set_script(buffer, plain(script_)->tag);
    hb_buffer_set_language(buffer, hb_language_get_default());
    hb_shape_plan_execute(plan(rightToLeft), font_.get(), buffer, nullptr, 0);
    unsigned count = 0;
    const hb_glyph_info_t* const infos = hb_buffer_get_glyph_infos(buffer, &count);
    const hb_glyph_position_t* const positions = hb_buffer_get_glyph_positions(buffer, &count);
    Word made;
    made.glyphs.reserve(count);
    unsigned last = 0;
    for (unsigned i = 0; i < count; ++i) {
        if (infos[i].codepoint == 0) {
            return std::nullopt;
        }
        made.glyphs.push_back({infos[i].codepoint, made.advance + positions[i].x_offset, positions[i].y_offset});
        made.advance += positions[i].x_advance;
        if (infos[i].cluster > infos[last].cluster) {
            last = i;
        }
    }
    if (count == 0) {
        return std::nullopt;
    }
    made.last = infos[last].codepoint;
    if (rightToLeft) {
        // Overlapping joints are blended from the right, as letters are.
        std::reverse(made.glyphs.begin(), made.glyphs.end());
    }
    return made;
}

}  // namespace ktr::linux_
