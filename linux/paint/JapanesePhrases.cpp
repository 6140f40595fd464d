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
        if (within && !phrases->isBoundary(static_cast<int32_t>(at))) {
            out.append(kWordJoiner);
        }
        out.append(text[at]);
    }
    return out;
}

}  // namespace ktr::linux_
