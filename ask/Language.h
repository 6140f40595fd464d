#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "ask/Grammar.h"
#include "ask/Meaning.h"
#include "documents/DocumentError.h"
#include "documents/FieldReader.h"

namespace ktr::ask {

/// All that asking and answering needs to know of one language, read from resources/questions (docs/asking.md).
/// Immutable; any thread.
class Language {
  public:
    /// What a time of day is said by.
    enum class Time { At, Pm, Noon, Tonight, Tomorrow, Minutes, Hours, HalfHour, OneHour };
    static constexpr std::size_t kTimes = 9;
    /// Somebody's kind of place: "home".
    struct PlaceKind {
        std::string label;  ///< as the service writes it: home, work, school, gym
        std::string said;   ///< where somebody is: "at home"
    };

    static std::variant<std::shared_ptr<const Language>, documents::DocumentError> read(
        const std::filesystem::path& file, const std::string& tag);
    /// The file for a language (BCP 47) in a folder: as it was asked for, then by script, then the language alone; none
    /// when there is none.
    static std::optional<std::filesystem::path> fileFor(const std::string& tag, const std::filesystem::path& folder);

    const std::string& tag() const { return tag_; }
    /// All ways to understand a question, the surest first; none when no template says all of it.
    std::vector<Meaning> meanings(const std::string& question) const;
    /// What a place's words mean before anybody looks for a place of that name: "me", or a kind's label; empty: a name.
    std::string placeWord(const std::string& words) const;
    const PlaceKind* kindOf(const std::string& label) const;
    /// The ways to say a moment, the surest first; the spans are of the folded text.
    std::vector<Grammar::Reading> times(const std::u32string& folded) const { return times_->read(folded); }

    /// Folded, with blanks where they belong: what stands between two names.
    const std::vector<std::u32string>& conjunctions() const { return conjunctions_; }
    /// Folded words for one relative each: {"mum", "mother"}.
    const std::vector<std::vector<std::u32string>>& relations() const { return relations_; }
    /// Folded endings of names, and what stands in their place in the name itself: {"'s", ""}.
    const std::vector<std::pair<std::u32string, std::u32string>>& endings() const { return endings_; }
    /// A number's word, folded, to its value.
    const std::map<std::u32string, int>& numbers() const { return numbers_; }
    /// A pattern by its key; a key that is missing reads as itself, which a test forbids.
    const std::string& sentence(const std::string& key) const;
    /// With "{name}" in the place of a friend's name.
    const std::vector<std::string>& suggestions() const { return suggestions_; }
    const std::map<std::string, std::string>& sentences() const { return sentences_; }

  private:
    explicit Language(std::string tag) : tag_(std::move(tag)) {}
    void readAll(documents::FieldReader& fields);
    void readQuestions(documents::FieldReader& fields);
    std::string spotOf(std::size_t number) const;
    void readWords(documents::FieldReader& fields);

    std::string tag_;
    std::unique_ptr<Grammar> questions_;
    std::unique_ptr<Grammar> places_;
    std::unique_ptr<Grammar> times_;
    std::vector<PlaceKind> kinds_;
    std::vector<std::u32string> conjunctions_;
    std::vector<std::vector<std::u32string>> relations_;
    std::vector<std::pair<std::u32string, std::u32string>> endings_;
    std::map<std::u32string, int> numbers_;
    std::map<std::string, std::string> sentences_;
    std::vector<std::string> suggestions_;
};

}  // namespace ktr::ask
