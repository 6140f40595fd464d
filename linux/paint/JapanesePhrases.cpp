#include "linux/paint/JapanesePhrases.h"

#include <algorithm>
#include <memory>

#include <unicode/brkiter.h>
#include <unicode/unistr.h>

namespace ktr::linux_ {

namespace {

constexpr QChar kWordJoiner(0x2060);
/// Beyond this a text is no sentence of a conversation.
constexpr qsizetype kLongest = 2000;

bool isKana(QChar c) {
    return c.unicode() >= 0x3041 && c.unicode() <= 0x30FF;
}

/// Endings of verbs ("ています"), which the phrases of the locale data part from their verbs.
bool isEnding(QChar before, QChar c) {
    constexpr char16_t kTe = 0x3066;
    constexpr char16_t kTa = 0x305F;
    constexpr char16_t kLastHiragana = 0x309F;
    return isKana(before) && before.unicode() <= kLastHiragana && (c.unicode() == kTe || c.unicode() == kTa);
}

bool isJapaneseLetter(QChar c) {
    return isKana(c) || (c.unicode() >= 0x3400 && c.unicode() <= 0x9FFF) || c.unicode() == 0x3005;
}

}  // namespace

QString JapanesePhrases::joined(const QString& text) {
    if (text.size() > kLongest || std::none_of(text.begin(), text.end(), isKana)) {
        return text;
    }
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::BreakIterator> phrases(
        icu::BreakIterator::createLineInstance(icu::Locale::forLanguageTag("ja-u-lw-phrase", status), status));
    if (U_FAILURE(status)) {
        return text;
    }
    const icu::UnicodeString wide(reinterpret_cast<const char16_t*>(text.utf16()), static_cast<int32_t>(text.size()));
    phrases->setText(wide);
    QString out;
    for (qsizetype at = 0; at < text.size(); ++at) {
        const bool within = at > 0 && isJapaneseLetter(text[at - 1]) && isJapaneseLetter(text[at]);
        if (within && (isEnding(text[at - 1], text[at]) || !phrases->isBoundary(static_cast<int32_t>(at)))) {
            out.append(kWordJoiner);
        }
        out.append(text[at]);
    }
    return out;
}

}  // namespace ktr::linux_
