#pragma once

#include <QString>

namespace ktr::linux_ {

/// Lines of Japanese may end between any two letters, and then do so in the middle of words. Stateless; any thread.
class JapanesePhrases {
  public:
    /// A text with the letters of each phrase, and a number and what it counts, held together by word joiners (U+2060),
    /// which have no width. A text without kana may be Chinese: there the numbers alone.
    static QString joined(const QString& text);
    /// Lets the joined phrase around a position be broken between its words: marks without a width (U+200B) take the
    /// joiners' places there. Whether anything became another; a phrase of one word does not.
    static bool loosen(QString& text, qsizetype at);
    /// Whether the character here stays on the line of the one before it: a closing bracket, a full stop, a small kana,
    /// a long vowel's mark, as Chinese and Japanese have them.
    static bool isBoundToBefore(const QString& text, qsizetype at);
};

}  // namespace ktr::linux_
