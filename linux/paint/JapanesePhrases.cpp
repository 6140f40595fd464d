#include "linux/paint/JapanesePhrases.h"

#include <algorithm>
#include <memory>

#include <unicode/brkiter.h>
#include <unicode/uchar.h>
#include <unicode/unistr.h>

namespace ktr::linux_ {

namespace {

constexpr QChar kWordJoiner(0x2060);
constexpr QChar kBreakMark(0x200B);
/// Beyond this a text is no sentence of a conversation.
constexpr qsizetype kLongest = 2000;
/// The first of the marks of Chinese and Japanese.
constexpr char16_t kFirstWide = 0x3000;

bool isKana(QChar c) {
    return c.unicode() >= 0x3041 && c.unicode() <= 0x30FF;
}

bool isKanji(QChar c) {
    return c.unicode() >= 0x3400 && c.unicode() <= 0x9FFF;
}

/// Endings of verbs ("ています"), which the phrases of the locale data part from their verbs.
bool isEnding(QChar before, QChar c) {
    constexpr char16_t kTe = 0x3066;
    constexpr char16_t kTa = 0x305F;
    constexpr char16_t kLastHiragana = 0x309F;
    return isKana(before) && before.unicode() <= kLastHiragana && (c.unicode() == kTe || c.unicode() == kTa);
}

bool isJapaneseLetter(QChar c) {
    return isKana(c) || isKanji(c) || c.unicode() == 0x3005;
}

bool isMark(QChar c) {
    return c == kWordJoiner || c == kBreakMark;
}

std::unique_ptr<icu::BreakIterator> phrasesOrWords(bool phrases, const icu::UnicodeString& text) {
    UErrorCode status = U_ZERO_ERROR;
    const auto locale = icu::Locale::forLanguageTag("ja-u-lb-strict-lw-phrase", status);
    std::unique_ptr<icu::BreakIterator> made(phrases ? icu::BreakIterator::createLineInstance(locale, status)
                                                     : icu::BreakIterator::createWordInstance(locale, status));
    if (U_FAILURE(status)) {
        return nullptr;
    }
    made->setText(text);
    return made;
}

icu::UnicodeString wide(const QString& text) {
    return {reinterpret_cast<const char16_t*>(text.utf16()), static_cast<int32_t>(text.size())};
}

/// Whether [from, at) is one kanji that no other is before, and the next letter another: they are the two halves of a
/// word ("見守る") that the locale data does not know.
bool isHalfOfAWord(const QString& text, qsizetype from, qsizetype at) {
    return at - from == 1 && isKanji(text[from]) && isKanji(text[at]) && (from == 0 || !isKanji(text[from - 1]));
}

bool isDigit(QChar c) {
    return (c.unicode() >= u'0' && c.unicode() <= u'9') || (c.unicode() >= 0xFF10 && c.unicode() <= 0xFF19);
}

/// A number is held to what it counts ("2人") in Chinese too.
bool isNumberAndCounter(QChar before, QChar c) {
    return isDigit(before) && isKanji(c);
}

}  // namespace

QString JapanesePhrases::joined(const QString& text) {
    if (text.size() > kLongest || std::none_of(text.begin(), text.end(), isJapaneseLetter)) {
        return text;
    }
    const bool isJapanese = std::any_of(text.begin(), text.end(), isKana);
    const icu::UnicodeString letters = wide(text);
    const auto phrases = isJapanese ? phrasesOrWords(true, letters) : nullptr;
    const auto isJoined = [&](qsizetype begin, qsizetype at) {
        const QChar before = text[at - 1];
        if (isNumberAndCounter(before, text[at])) {
            return true;
        }
        return phrases && isJapaneseLetter(before) && isJapaneseLetter(text[at]) &&
               (isEnding(before, text[at]) || isHalfOfAWord(text, begin, at) ||
                !phrases->isBoundary(static_cast<int32_t>(at)));
    };
    QString out;
    qsizetype begin = 0;
    for (qsizetype at = 0; at < text.size(); ++at) {
        if (at > 0 && isJoined(begin, at)) {
            out.append(kWordJoiner);
        } else {
            begin = at;
        }
        out.append(text[at]);
    }
    return out;
}

bool JapanesePhrases::loosen(QString& text, qsizetype at) {
    // The letters around it, whatever holds them together: words show in their surroundings.
    const auto belongs = [&text](qsizetype i) {
        return isJapaneseLetter(text[i]) || isDigit(text[i]) || isMark(text[i]);
    };
    qsizetype from = at;
    while (from > 0 && at - from < kLongest && belongs(from - 1)) {
        --from;
    }
    qsizetype to = at;
    while (to < text.size() && to - at < kLongest && belongs(to)) {
        ++to;
    }
    // The phrase, in which each letter is joined to the one before it.
    qsizetype phrase = at;
    while (phrase > from && (isMark(text[phrase - 1]) || (phrase - 1 > from && isMark(text[phrase - 2])))) {
        --phrase;
    }
    qsizetype end = at;
    while (end < to && (isMark(text[end]) || (end > from && isMark(text[end - 1])))) {
        ++end;
    }
    QString letters = text.mid(from, to - from);
    letters.removeIf(isMark);
    const icu::UnicodeString units = wide(letters);
    const auto words = phrasesOrWords(false, units);
    if (!words) {
        return false;
    }
    bool loosened = false;
    qsizetype letter = 0;
    qsizetype word = 0;
    for (qsizetype i = from; i < to; ++i) {
        if (!isMark(text[i])) {
            ++letter;
            continue;
        }
        if (letter == 0 || letter >= letters.size() || isEnding(letters[letter - 1], letters[letter]) ||
            isHalfOfAWord(letters, word, letter) || isBoundToBefore(letters, letter) ||
            !words->isBoundary(static_cast<int32_t>(letter))) {
            continue;
        }
        word = letter;
        if (i >= phrase && i < end && text[i] == kWordJoiner) {
            text[i] = kBreakMark;
            loosened = true;
        }
    }
    return loosened;
}

bool JapanesePhrases::isBoundToBefore(const QString& text, qsizetype at) {
    const auto isWide = [](QChar c) { return c.unicode() >= kFirstWide && !c.isSurrogate(); };
    while (at < text.size() && isMark(text[at])) {
        ++at;
    }
    qsizetype before = std::min(at, text.size());
    while (before > 0 && isMark(text[before - 1])) {
        --before;
    }
    if (at >= text.size() || before == 0 || (!isWide(text[at]) && !isWide(text[before - 1]))) {
        return false;
    }
    switch (u_getIntPropertyValue(text[at].unicode(), UCHAR_LINE_BREAK)) {
        case U_LB_CLOSE_PUNCTUATION:
        case U_LB_CLOSE_PARENTHESIS:
        case U_LB_EXCLAMATION:
        case U_LB_INFIX_NUMERIC:
        case U_LB_NONSTARTER:
        case U_LB_CONDITIONAL_JAPANESE_STARTER:
            return true;
        default:
            return false;
    }
}

}  // namespace ktr::linux_
