#pragma once

#include <atomic>

#include "platform/text/TextEngine.h"

namespace ktr::test {

/// A text engine whose every glyph (code point) is one em wide, so that each rectangle is exact on any machine. Words
/// are split at blanks, and at soft hyphens where the container hyphenates; "\n" ends a paragraph; a word wider than
/// its line breaks anywhere but before a mark of Japanese that begins no line. Line boxes and baselines are the font's
/// own. An ellipsis is one glyph, and so is a hyphen.
class FixedTextEngine : public platform::TextEngine {
  public:
    std::shared_ptr<const platform::TextLayout> layOut(const platform::AttributedString& text,
                                                       const platform::TextContainer& container) override;
    /// How many texts were laid out. Any thread.
    int count() const { return count_; }

  private:
    std::atomic<int> count_ = 0;
};

}  // namespace ktr::test
