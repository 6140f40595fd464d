#include "linux/paint/WordShaper.h"

#include <QCoreApplication>
#include <QGlyphRun>
#include <QRawFont>
#include <QTextLayout>
#include <algorithm>
#include <cmath>

#include "linux/paint/ShapeRecipe.h"
#include "linux/paint/WordFont.h"

namespace ktr::linux_ {

namespace {

constexpr double kUnits = 64.0;  // a pixel
/// Half of the words that are kept at most; a word takes some 200 bytes.
constexpr std::size_t kMostWords = 2000;
constexpr double kEndless = 60000.0;

int units(double pixels) {
    return static_cast<int>(std::lround(pixels * kUnits));
}

/// Fonts belong to the main thread, words may be dropped by any: they hold numbers.
std::vector<QRawFont>& knownFonts() {
    static std::vector<QRawFont> known = [] {
        qAddPostRoutine([] { known.clear(); });
        return std::vector<QRawFont>();
    }();
    return known;
}

quint16 fontNumber(const QRawFont& font) {
    auto& known = knownFonts();
    const auto found = std::find(known.begin(), known.end(), font);
    if (found == known.end()) {
        known.push_back(font);
        return static_cast<quint16>(known.size() - 1);
    }
    return static_cast<quint16>(found - known.begin());
}

bool belongsToEveryScript(QStringView word) {
    return std::all_of(word.begin(), word.end(), [](QChar c) { return c.script() == QChar::Script_Common; });
}

}  // namespace

const QRawFont& WordShaper::font(quint16 number) {
    return knownFonts()[number];
}

std::size_t WordShaper::numberOf(const Setting& setting) {
    if (lastSetting_ < settings_.size() && settings_[lastSetting_] == setting) {
        return lastSetting_;
    }
    const auto found = std::find(settings_.begin(), settings_.end(), setting);
    lastSetting_ = static_cast<std::size_t>(found - settings_.begin());
    if (found == settings_.end()) {
        settings_.push_back(setting);
    }
    return lastSetting_;
}

const WordShaper::Word* WordShaper::shaped(const FontSpec& font, QChar::Script script, QStringView word,
                                           bool rightToLeft) {
    const Setting setting = {font, script, rightToLeft};
    const KeyView key = {numberOf(setting), word};
    if (const auto found = words_.find(key); found != words_.end()) {
        return ifCertain(found->second);
    }
    if (const auto found = older_.find(key); found != older_.end()) {
        auto node = older_.extract(found);
        return keep(std::move(node.key()), std::move(node.mapped()));
    }
    ++shaped_;
    return keep({key.font, word.toString()}, shapedOnce(setting, word));
}

const WordShaper::Word* WordShaper::keep(Key key, Word word) {
    if (words_.size() >= kMostWords) {
        older_ = std::move(words_);
        words_.clear();
    }
    return ifCertain(words_.insert_or_assign(std::move(key), std::move(word)).first->second);
}

WordShaper::Word WordShaper::shapedOnce(const Setting& setting, QStringView word) {
    WordFont* font = WordFont::of(setting.font, setting.script);
    if (font == nullptr && !setting.rightToLeft && belongsToEveryScript(word)) {
        // A number beside letters of another family: alone, as Qt would be given it, it has no script.
        font = WordFont::of(setting.font, QChar::Script_Common);
    }
    const auto letters = font != nullptr ? font->shaped(word, setting.rightToLeft) : std::nullopt;
    Word made;
    if (letters) {
        made.advance = letters->advance;
        made.overhang = font->overhang(letters->last);
        made.glyphs.reserve(letters->glyphs.size());
        const quint16 number = fontNumber(font->raw());
        for (const WordFont::Glyph& glyph : letters->glyphs) {
            made.glyphs.push_back({static_cast<quint16>(glyph.index), number, glyph.x, glyph.y});
        }
        return made;
    }
    // Fonts for letters that their own script's lacks depend on what else is in the line; those for emoji do not.
    const auto letterIn = [font](char32_t c) {
        const QChar::Script script = QChar::script(c);
        return script == QChar::Script_Common || script == QChar::Script_Inherited ||
               (font != nullptr && font->raw().supportsCharacter(c));
    };
    const auto characters = word.toUcs4();
    made.isCertain = std::all_of(characters.begin(), characters.end(), letterIn);
    if (!made.isCertain) {
        return made;
    }
    ++shapedByQt_;
    return shapedByQt(setting, word);
}

WordShaper::Word WordShaper::shapedByQt(const Setting& setting, QStringView word) {
    ShapeRecipe recipe;
    recipe.text = word.toString();
    recipe.direction = setting.rightToLeft ? Qt::RightToLeft : Qt::LeftToRight;
    recipe.font = setting.font;
    recipe.font.family = FontChoice::baseFamily();
    if (!(recipe.font == setting.font)) {
        recipe.ranges.push_back({0, word.size(), setting.font});
    }
    const auto layout = recipe.layout({{kEndless, QPointF()}});
    const QTextLine line = layout->lineAt(0);
    Word made;
    made.advance = units(line.horizontalAdvance());
    made.overhang = units(line.naturalTextWidth()) - made.advance;
    for (const QGlyphRun& run : line.glyphRuns()) {
        const quint16 number = fontNumber(run.rawFont());
        const auto indexes = run.glyphIndexes();
        const auto positions = run.positions();
        for (qsizetype i = 0; i < indexes.size(); ++i) {
            made.glyphs.push_back({static_cast<quint16>(indexes[i]), number, units(positions[i].x()),
                                   units(positions[i].y() - line.ascent())});
        }
    }
    return made;
}

}  // namespace ktr::linux_
