#include "serve/QuestionWords.h"

#include <algorithm>

namespace ktr::serve {

QuestionWords::QuestionWords(const std::string& text) : words_(QString{}) {
    for (const char32_t c : QString::fromStdString(text).toCaseFolded().toStdU32String()) {
        if (c == U'\'' || c == U'\u2019') {
            continue;
        }
        if (QChar::isLetterOrNumber(c) || QChar::isMark(c) || c == U'@' || c == U'.' || c == U'+' || c == U'-') {
            words_.back() += QString::fromUcs4(&c, 1);
        } else if (!words_.back().isEmpty()) {
            words_.append(QString());
        }
    }
    for (QString& word : words_) {
        while (word.endsWith(QLatin1Char('.'))) {
            word.chop(1);
        }
    }
    words_.removeAll(QString());
}

bool QuestionWords::isAny(const QString& word, std::initializer_list<const char*> wanted) {
    return std::any_of(wanted.begin(), wanted.end(), [&](const char* one) { return word == QLatin1String(one); });
}

bool QuestionWords::hasAny(std::initializer_list<const char*> wanted) const {
    return std::any_of(words_.begin(), words_.end(), [&](const QString& word) { return isAny(word, wanted); });
}

bool QuestionWords::holds(const QuestionWords& part) const {
    return !part.words_.isEmpty() &&
           std::search(words_.begin(), words_.end(), part.words_.begin(), part.words_.end()) != words_.end();
}

bool QuestionWords::startsWithAny(std::initializer_list<const char*> wanted) const {
    return !words_.isEmpty() && isAny(words_.front(), wanted);
}

}  // namespace ktr::serve
