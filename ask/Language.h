#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <optional>
#include <set>
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

    /// Longer tags there are none of: whatever claims to be one has no file.
    static constexpr std::size_t kLongestTag = 64;

    static std::variant<std::shared_ptr<const Language>, documents::DocumentError> read(
        const std::filesystem::path& file, const std::string& tag);
    /// Which of the files, named without their ending, serves a language (BCP 47): as it was asked for, then by script,
    /// then the language alone. None when none does.
    static std::optional<std::string> fileFor(const std::string& tag, const std::set<std::string>& files);
    /// The same language under another tag that its file serves ("en-GB"). What the file says is not copied.
    std::shared_ptr<const Language> under(const std::string& tag) const;

    const std::string& tag() const { return tag_; }
    /// All ways to understand a question, the surest first; none when no template says all of it.
    std::vector<Meaning> meanings(const std::string& question) const;
    /// What a place's words mean before anybody looks for a place of that name: "me", or a kind's label; empty: a name.
    std::string placeWord(const std::string& words) const;
    const PlaceKind* kindOf(const std::string& label) const;
    /// The ways to say a moment, the surest first; the spans are of the folded text.
    std::vector<Grammar::Reading> times(const std::u32string& folded) const { return file_->times->read(folded); }

    /// Folded, with blanks where they belong: what stands between two names.
    const std::vector<std::u32string>& conjunctions() const { return file_->conjunctions; }
    /// Folded words for one relative each: {"mum", "mother"}.
    const std::vector<std::vector<std::u32string>>& relations() const { return file_->relations; }
    /// Folded endings of names, and what stands in their place in the name itself: {"'s", ""}.
    const std::vector<std::pair<std::u32string, std::u32string>>& endings() const { return file_->endings; }
    /// A number's word, folded, to its value.
    const std::map<std::u32string, int>& numbers() const { return file_->numbers; }
    /// A pattern by its key; a key that is missing reads as itself, which a test forbids.
    const std::string& sentence(const std::string& key) const;
    /// With "{name}" in the place of a friend's name.
    const std::vector<std::string>& suggestions() const { return file_->suggestions; }
    const std::map<std::string, std::string>& sentences() const { return file_->sentences; }

  private:
    /// What the file says: one of it, whatever the tags that it serves.
    struct File {
        void readAll(documents::FieldReader& fields);
        void readQuestions(documents::FieldReader& fields);
        void readWords(documents::FieldReader& fields);

        std::unique_ptr<Grammar> questions;
        std::unique_ptr<Grammar> places;
        std::unique_ptr<Grammar> times;
        std::vector<PlaceKind> kinds;
        std::vector<std::u32string> conjunctions;
        std::vector<std::vector<std::u32string>> relations;
        std::vector<std::pair<std::u32string, std::u32string>> endings;
        std::map<std::u32string, int> numbers;
        std::map<std::string, std::string> sentences;
        std::vector<std::string> suggestions;
    };

    Language(std::string tag, std::shared_ptr<const File> file) : tag_(std::move(tag)), file_(std::move(file)) {}
    std::string spotOf(std::size_t number) const;

    std::string tag_;
    std::shared_ptr<const File> file_;
};

}  // namespace ktr::ask
