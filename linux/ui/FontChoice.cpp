#include "linux/ui/FontChoice.h"

#include <QFontDatabase>
#include <QSet>
#include <algorithm>
#include <array>
#include <bitset>
#include <utility>

namespace ktr::linux_ {

namespace {

struct ScriptFamily {
    QChar::Script script;
    const char* family;
};

/// Scripts beyond Latin, Greek and Cyrillic that have a face of their own; Han, kana and hangul are chosen by language.
constexpr std::array kScriptFamilies = {
    ScriptFamily{QChar::Script_Arabic, "Noto Sans Arabic"},
    ScriptFamily{QChar::Script_Hebrew, "Noto Sans Hebrew"},
    ScriptFamily{QChar::Script_Armenian, "Noto Sans Armenian"},
    ScriptFamily{QChar::Script_Georgian, "Noto Sans Georgian"},
    ScriptFamily{QChar::Script_Devanagari, "Noto Sans Devanagari"},
    ScriptFamily{QChar::Script_Bengali, "Noto Sans Bengali"},
    ScriptFamily{QChar::Script_Gurmukhi, "Noto Sans Gurmukhi"},
    ScriptFamily{QChar::Script_Gujarati, "Noto Sans Gujarati"},
    ScriptFamily{QChar::Script_Oriya, "Noto Sans Oriya"},
    ScriptFamily{QChar::Script_Tamil, "Noto Sans Tamil"},
    ScriptFamily{QChar::Script_Telugu, "Noto Sans Telugu"},
    ScriptFamily{QChar::Script_Kannada, "Noto Sans Kannada"},
    ScriptFamily{QChar::Script_Malayalam, "Noto Sans Malayalam"},
    ScriptFamily{QChar::Script_Sinhala, "Noto Sans Sinhala"},
    ScriptFamily{QChar::Script_Thai, "Noto Sans Thai"},
    ScriptFamily{QChar::Script_Lao, "Noto Sans Lao"},
    ScriptFamily{QChar::Script_Tibetan, "Noto Serif Tibetan"},
    ScriptFamily{QChar::Script_Myanmar, "Noto Sans Myanmar"},
    ScriptFamily{QChar::Script_Ethiopic, "Noto Sans Ethiopic"},
    ScriptFamily{QChar::Script_Khmer, "Noto Sans Khmer"},
    ScriptFamily{QChar::Script_Mongolian, "Noto Sans Mongolian"},
    ScriptFamily{QChar::Script_Cherokee, "Noto Sans Cherokee"},
    ScriptFamily{QChar::Script_CanadianAboriginal, "Noto Sans Canadian Aboriginal"},
    ScriptFamily{QChar::Script_Syriac, "Noto Sans Syriac"},
    ScriptFamily{QChar::Script_Thaana, "Noto Sans Thaana"},
    ScriptFamily{QChar::Script_Nko, "Noto Sans NKo"},
    ScriptFamily{QChar::Script_Tifinagh, "Noto Sans Tifinagh"},
    ScriptFamily{QChar::Script_Javanese, "Noto Sans Javanese"},
    ScriptFamily{QChar::Script_Balinese, "Noto Sans Balinese"},
    ScriptFamily{QChar::Script_Sundanese, "Noto Sans Sundanese"},
    ScriptFamily{QChar::Script_Adlam, "Noto Sans Adlam"},
    ScriptFamily{QChar::Script_OlChiki, "Noto Sans Ol Chiki"},
    ScriptFamily{QChar::Script_Coptic, "Noto Sans Coptic"},
    ScriptFamily{QChar::Script_Yi, "Noto Sans Yi"},
    ScriptFamily{QChar::Script_Vai, "Noto Sans Vai"},
    ScriptFamily{QChar::Script_Lisu, "Noto Sans Lisu"},
    ScriptFamily{QChar::Script_MeeteiMayek, "Noto Sans Meetei Mayek"},
    ScriptFamily{QChar::Script_Chakma, "Noto Sans Chakma"},
    ScriptFamily{QChar::Script_Cham, "Noto Sans Cham"},
    ScriptFamily{QChar::Script_TaiTham, "Noto Sans Tai Tham"},
    ScriptFamily{QChar::Script_TaiViet, "Noto Sans Tai Viet"},
    ScriptFamily{QChar::Script_HanifiRohingya, "Noto Sans Hanifi Rohingya"},
    ScriptFamily{QChar::Script_Runic, "Noto Sans Runic"},
    ScriptFamily{QChar::Script_Gothic, "Noto Sans Gothic"},
};

/// Digits and punctuation that several scripts share count for the script whose block they stand in, since that is
/// whose font has them.
QChar::Script scriptOf(char32_t c) {
    const QChar::Script script = QChar::script(c);
    if (script != QChar::Script_Common && script != QChar::Script_Inherited) {
        return script;
    }
    if (c >= 0x0590 && c <= 0x05FF) {
        return QChar::Script_Hebrew;
    }
    if (c >= 0x0600 && c <= 0x08FF) {
        return QChar::Script_Arabic;
    }
    if (c >= 0x0900 && c <= 0x097F) {
        return QChar::Script_Devanagari;
    }
    if ((c >= 0x3000 && c <= 0x33FF) || (c >= 0xFE30 && c <= 0xFE4F) || (c >= 0xFF00 && c <= 0xFFEF)) {
        return QChar::Script_Han;
    }
    return script;
}

bool isSymbol(char32_t c) {
    return (c >= 0x2100 && c <= 0x2BFF) || (c >= 0x1D400 && c <= 0x1FBFF);
}

using Scripts = std::bitset<QChar::ScriptCount>;

struct Found {
    Scripts scripts;
    bool symbols = false;
};

Found scan(QStringView text) {
    Found found;
    // Enough of a text names its scripts; what a stray character beyond needs, the system's own fallback finds.
    constexpr qsizetype kMost = 20000;
    const qsizetype end = std::min(text.size(), kMost);
    for (qsizetype i = 0; i < end; ++i) {
        char32_t c = text[i].unicode();
        if (c < 0x0590) {
            if (c >= 0x0530) {
                found.scripts.set(QChar::Script_Armenian);
            }
            continue;
        }
        if (text[i].isHighSurrogate() && i + 1 < text.size() && text[i + 1].isLowSurrogate()) {
            c = QChar::surrogateToUcs4(text[i], text[i + 1]);
            ++i;
        }
        found.scripts.set(static_cast<std::size_t>(scriptOf(c)));
        found.symbols = found.symbols || isSymbol(c);
    }
    return found;
}

}  // namespace

const QString& FontChoice::baseFamily() {
    static const QString kFamily = QStringLiteral("Noto Sans");
    return kFamily;
}

const QString& FontChoice::emojiFamily() {
    static const QString kFamily = QStringLiteral("Noto Color Emoji");
    return kFamily;
}

QString FontChoice::hanFamily(bool kana, bool hangul) const {
    const QString language = language_.toLower();
    if (kana) {
        return QStringLiteral("Noto Sans CJK JP");
    }
    if (hangul || language.startsWith(u"ko")) {
        return QStringLiteral("Noto Sans CJK KR");
    }
    if (language.startsWith(u"zh")) {
        if (language.contains(u"hk") || language.contains(u"mo")) {
            return QStringLiteral("Noto Sans CJK HK");
        }
        const bool traditional = language.contains(u"hant") || language.contains(u"tw");
        return traditional ? QStringLiteral("Noto Sans CJK TC") : QStringLiteral("Noto Sans CJK SC");
    }
    return QStringLiteral("Noto Sans CJK JP");
}

QStringList FontChoice::families(QStringView text) const {
    const Found found = scan(text);
    QStringList list{baseFamily()};
    for (const ScriptFamily& entry : kScriptFamilies) {
        if (found.scripts.test(entry.script)) {
            list.append(QString::fromLatin1(entry.family));
        }
    }
    const bool kana = found.scripts.test(QChar::Script_Hiragana) || found.scripts.test(QChar::Script_Katakana);
    const bool hangul = found.scripts.test(QChar::Script_Hangul);
    if (kana || hangul || found.scripts.test(QChar::Script_Han) || found.scripts.test(QChar::Script_Bopomofo)) {
        list.append(hanFamily(kana, hangul));
    }
    // Before the text fonts the emoji font would take the digits; after the symbol fonts it would lose its colours.
    list.append(emojiFamily());
    if (found.symbols) {
        list.append({QStringLiteral("Noto Sans Symbols"), QStringLiteral("Noto Sans Symbols2"),
                     QStringLiteral("Noto Sans Math")});
    }
    list.append({QStringLiteral("DejaVu Sans"), QStringLiteral("sans-serif")});
    return list;
}

bool FontChoice::hasStyle(const QString& family, const QString& style) {
    return QFontDatabase::styles(family).contains(style);
}

QFont FontChoice::font(const platform::Font& wanted, int pixelSize, QStringView text) const {
    // Looked up once: fonts are added before the first text is shaped, if at all.
    static const bool kLight = hasStyle(baseFamily(), QStringLiteral("Light"));
    static const bool kThin = hasStyle(baseFamily(), QStringLiteral("Thin"));
    QFont::Weight weight = wanted.weight == platform::FontWeight::Regular ? QFont::Normal : QFont::Bold;
    if (weight == QFont::Normal && wanted.face == platform::FontFace::Light && kLight) {
        weight = QFont::Light;
    } else if (weight == QFont::Normal && wanted.face == platform::FontFace::Thin && kThin) {
        weight = QFont::Thin;
    }
    QFont font;
    font.setFamilies(families(text));
    font.setPixelSize(pixelSize);
    font.setWeight(weight);
    font.setHintingPreference(QFont::PreferNoHinting);
    font.setStyleStrategy(static_cast<QFont::StyleStrategy>(QFont::PreferAntialias | QFont::NoSubpixelAntialias));
    return font;
}

}  // namespace ktr::linux_
