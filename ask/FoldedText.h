#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace ktr::ask {

/// A text as questions, templates and names are compared: in lower case, without accents and punctuation, one form for
/// letters that are written in several ways, one blank between words, none at the ends and none beside a letter of a
/// script that is written without blanks. Each letter knows where it stood. Any thread.
class FoldedText {
  public:
    /// Broken UTF-8 is read as far as it goes, with a mark in the place of what is broken.
    explicit FoldedText(std::string_view text);

    const std::u32string& letters() const { return letters_; }
    bool empty() const { return letters_.empty(); }
    /// The part of the original text behind the letters from `begin` to `end`, without blanks and punctuation around
    /// it.
    std::string original(std::size_t begin, std::size_t end) const;

    /// The letters alone.
    static std::u32string of(std::string_view text) { return FoldedText(text).letters(); }
    /// Whether blanks beside this letter say nothing: Han, kana, Hangul.
    static bool isWithoutBlanks(char32_t letter);

  private:
    void append(char32_t letter, std::size_t at);

    std::string text_;
    std::u32string letters_;
    std::vector<std::size_t> places_;  ///< of each letter, the byte in `text_` at which it began
};

}  // namespace ktr::ask
