#include "linux/paint/FontChoice.h"

#include <QFontDatabase>
#include <array>
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

bool isHanScript(QChar::Script script) {
    return script == QChar::Script_Han || script == QChar::Script_Hiragana || script == QChar::Script_Katakana ||
           script == QChar::Script_Hangul || script == QChar::Script_Bopomofo;
}

/// The script's own family, or an empty text for what the base family is for.
QString ownFamily(QChar::Script script) {
    for (const ScriptFamily& entry : kScriptFamilies) {
        if (entry.script == script) {
            return QString::fromLatin1(entry.family);
        }
    }
    return {};
}

bool staysWithPrevious(char32_t c) {
    // Marks, joiners and the like; an emoji's parts are all in the base family's list anyway.
    return QChar::script(c) == QChar::Script_Inherited || c == 0x200C || c == 0x200D || QChar::isMark(c);
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

QString FontChoice::hanFamily(QStringView text) const {
    bool kana = false;
    bool hangul = false;
    // Enough of a text shows what it is written in.
    constexpr qsizetype kMost = 10000;
    for (const QChar c : text.left(kMost)) {
        kana = kana || c.script() == QChar::Script_Hiragana || c.script() == QChar::Script_Katakana;
        hangul = hangul || c.script() == QChar::Script_Hangul;
    }
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

std::vector<FontChoice::Stretch> FontChoice::stretches(QStringView text) const {
    std::vector<Stretch> list;
    QString han;
    QChar::Script lastScript = QChar::Script_Latin;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const qsizetype start = i;
        char32_t c = text[i].unicode();
        if (text[i].isHighSurrogate() && i + 1 < text.size() && text[i + 1].isLowSurrogate()) {
            c = QChar::surrogateToUcs4(text[i], text[i + 1]);
            ++i;
        }
        const bool known = !list.empty();
        const QChar::Script script = c < 0x0530 ? QChar::Script_Latin : scriptOf(c);
        if (known && (script == lastScript || staysWithPrevious(c))) {
            list.back().length = i + 1 - list.back().start;
            continue;
        }
        lastScript = script;
        QString family = baseFamily();
        if (isHanScript(script)) {
            han = han.isEmpty() ? hanFamily(text) : han;
            family = han;
        } else if (const QString own = ownFamily(script); !own.isEmpty()) {
            family = own;
        }
        if (known && list.back().family == family) {
            list.back().length = i + 1 - list.back().start;
        } else {
            list.push_back({start, i + 1 - start, family});
        }
    }
    return list;
}

bool FontChoice::hasStyle(const QString& family, const QString& style) {
    return QFontDatabase::styles(family).contains(style);
}

FontSpec FontChoice::spec(const platform::Font& wanted, int pixelSize, const QString& family) {
    // Looked up once: fonts are added before the first text is shaped, if at all.
    static const bool kLight = hasStyle(baseFamily(), QStringLiteral("Light"));
    static const bool kThin = hasStyle(baseFamily(), QStringLiteral("Thin"));
    QFont::Weight weight = wanted.weight == platform::FontWeight::Regular ? QFont::Normal : QFont::Bold;
    if (weight == QFont::Normal && wanted.face == platform::FontFace::Light && kLight) {
        weight = QFont::Light;
    } else if (weight == QFont::Normal && wanted.face == platform::FontFace::Thin && kThin) {
        weight = QFont::Thin;
    }
    return {family, pixelSize, weight};
}

QFont FontSpec::make() const {
    QStringList families{family};
    if (family != FontChoice::baseFamily()) {
        families.append(FontChoice::baseFamily());
    }
    // Before the text fonts the emoji font would take the digits; after the symbol fonts it would lose its colours.
    families.append(FontChoice::emojiFamily());
    if (family == FontChoice::baseFamily()) {
        // Symbols are set in the base family; Qt looks each name up again for each stretch in another family.
        families.append({QStringLiteral("Noto Sans Symbols"), QStringLiteral("Noto Sans Symbols2"),
                         QStringLiteral("Noto Sans Math")});
    }
    families.append({QStringLiteral("DejaVu Sans"), QStringLiteral("sans-serif")});
    QFont font;
    font.setFamilies(families);
    font.setPixelSize(pixelSize);
    font.setWeight(weight);
    font.setHintingPreference(QFont::PreferNoHinting);
    font.setStyleStrategy(static_cast<QFont::StyleStrategy>(QFont::PreferAntialias | QFont::NoSubpixelAntialias));
    return font;
}

const FontSpec::Made& FontSpec::made() const {
    // A QFont finds its engine once and keeps it; making one for each text finds it again each time. By thread, as
    // fonts belong to the thread that loaded them.
    thread_local std::vector<std::pair<FontSpec, Made>> known;
    for (const auto& [spec, made] : known) {
        if (spec == *this) {
            return made;
        }
    }
    if (known.size() == kMostKept) {
        known.clear();
    }
    Made made;
    made.font = make();
    made.format.setFont(made.font);
    known.reserve(kMostKept);
    return known.emplace_back(*this, std::move(made)).second;
}

}  // namespace ktr::linux_
