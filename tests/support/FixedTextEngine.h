#pragma once

#include "platform/text/TextEngine.h"

namespace ktr::test {

/// A text engine whose every glyph (code point) is one em wide, so that each rectangle is exact on any machine. Words
/// are split at blanks; "\n" ends a paragraph; a word wider than its line breaks anywhere. Line boxes and baselines are
/// the font's own. An ellipsis is one glyph.
class FixedTextEngine : public platform::TextEngine {
  public:
    std::shared_ptr<const platform::TextLayout> layOut(const platform::AttributedString& text,
                                                       const platform::TextContainer& container) override;
    /// How many texts were laid out.
    int count() const { return count_; }

  private:
    int count_ = 0;
};

}  // namespace ktr::test
