#include "linux/paint/Initials.h"

#include <QStringList>
#include <QTextBoundaryFinder>

#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

enum class Kind { Separate, Joined, Ideographic };

constexpr double kCapital = 0.357;
constexpr double kHebrew = 0.30;
constexpr double kArabic = 0.26;
constexpr double kIdeographic = 0.375;

char32_t firstCodePoint(const QString& text) {
    if (text.size() > 1 && text[0].isHighSurrogate()) {
        return QChar::surrogateToUcs4(text[0], text[1]);
    }
    return text.isEmpty() ? 0 : text[0].unicode();
}

QChar::Script scriptOf(const QString& grapheme) {
    return QChar::script(firstCodePoint(grapheme));
}

Kind kindOf(QChar::Script script) {
    switch (script) {
        case QChar::Script_Arabic:
        case QChar::Script_Syriac:
        case QChar::Script_Nko:
        case QChar::Script_Mongolian:
        case QChar::Script_Adlam:
        case QChar::Script_Devanagari:
        case QChar::Script_Bengali:
        case QChar::Script_Gurmukhi:
        case QChar::Script_Gujarati:
        case QChar::Script_Oriya:
        case QChar::Script_Tamil:
        case QChar::Script_Telugu:
        case QChar::Script_Kannada:
        case QChar::Script_Malayalam:
        case QChar::Script_Sinhala:
        case QChar::Script_Tibetan:
        case QChar::Script_Myanmar:
        case QChar::Script_Khmer:
        case QChar::Script_Javanese:
        case QChar::Script_Balinese:
        case QChar::Script_Thai:
        case QChar::Script_Lao:
            return Kind::Joined;
        case QChar::Script_Han:
        case QChar::Script_Hiragana:
        case QChar::Script_Katakana:
        case QChar::Script_Hangul:
        case QChar::Script_Bopomofo:
        case QChar::Script_Yi:
            return Kind::Ideographic;
        default:
            return Kind::Separate;
    }
}

QString upper(const QString& grapheme) {
    // The capitals of Georgian are for headlines; names are never written with one, and few fonts have them.
    if (scriptOf(grapheme) == QChar::Script_Georgian) {
        return grapheme;
    }
    const QString raised = grapheme.toUpper();
    QTextBoundaryFinder finder(QTextBoundaryFinder::Grapheme, raised);
    return finder.toNextBoundary() == raised.size() ? raised : grapheme;  // one letter may become two
}

/// The first grapheme that is a letter or a digit: quotes, marks of direction and emoji are passed over.
QString initialOf(const QString& name) {
    QTextBoundaryFinder finder(QTextBoundaryFinder::Grapheme, name);
    qsizetype start = 0;
    for (qsizetype end = finder.toNextBoundary(); end > 0; end = finder.toNextBoundary()) {
        const QString grapheme = name.mid(start, end - start);
        const char32_t c = firstCodePoint(grapheme);
        // A digit with marks behind it is a keycap.
        const bool keycap = QChar::isDigit(c) && grapheme.size() > 1 && c < 0x80;
        if (QChar::isLetterOrNumber(c) && !keycap && c != QChar::ReplacementCharacter) {
            return upper(grapheme);
        }
        start = end;
    }
    return {};
}

/// A name may be of any length; its initial stands near its beginning.
QString decoded(const std::string& utf8) {
    constexpr std::size_t kEnough = 1024;
    return QString::fromStdString(platform::sanitizedUtf8(std::string_view(utf8).substr(0, kEnough)));
}

struct Names {
    QString given;
    QString family;
};

Names namesOf(const platform::Contact& contact) {
    Names names{initialOf(decoded(contact.givenName)), initialOf(decoded(contact.familyName))};
    if (!names.given.isEmpty() || !names.family.isEmpty()) {
        return names;
    }
    const QStringList words = decoded(contact.storedFullName).simplified().split(u' ');
    names.given = initialOf(words.first());
    names.family = words.size() > 1 ? initialOf(words.last()) : QString();
    if (kindOf(scriptOf(names.given)) == Kind::Ideographic) {
        names.family.clear();  // the family name is written first
    }
    for (const std::string* other : {&contact.nickname, &contact.organizationName}) {
        if (names.given.isEmpty() && names.family.isEmpty()) {
            names.given = initialOf(decoded(*other));
        }
    }
    return names;
}

double baselineOf(QChar::Script script) {
    if (script == QChar::Script_Hebrew) {
        return kHebrew;
    }
    if (script == QChar::Script_Arabic || script == QChar::Script_Syriac) {
        return kArabic;
    }
    return kindOf(script) == Kind::Ideographic ? kIdeographic : kCapital;
}

}  // namespace

Initials::Initials(const platform::Contact& contact) {
    const Names names = namesOf(contact);
    const QString leading = names.given.isEmpty() ? names.family : names.given;
    switch (kindOf(scriptOf(leading))) {
        case Kind::Ideographic:
            letters_ = names.family.isEmpty() ? names.given : names.family;
            break;
        case Kind::Joined:
            letters_ = leading;
            break;
        case Kind::Separate:
            letters_ = leading;
            if (!names.given.isEmpty() && kindOf(scriptOf(names.family)) == Kind::Separate) {
                letters_ += names.family;
            }
            break;
    }
    baseline_ = baselineOf(scriptOf(letters_));
}

}  // namespace ktr::linux_
