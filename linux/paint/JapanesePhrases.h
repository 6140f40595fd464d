#pragma once

#include <QString>

namespace ktr::linux_ {

/// Lines of Japanese may end between any two letters, and then do so in the middle of words. Stateless; any thread.
class JapanesePhrases {
  public:
    /// A text with the letters of each phrase held together by word joiners (U+2060), which have no width; any other
    /// text as it is. A phrase that fits no line is broken all the same.
    static QString joined(const QString& text);
};

}  // namespace ktr::linux_
