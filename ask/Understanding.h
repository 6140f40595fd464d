#pragma once

#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "ask/Answer.h"
#include "ask/Language.h"
#include "ask/People.h"
#include "ask/Question.h"

namespace ktr::ask {

/// A question whose every word has been understood, and found among the contacts where it names somebody.
struct Understood {
    Meaning meaning;
    std::vector<const Person*> people;  ///< in the question's order
    /// The place: "me", a kind of place ("home"), or empty for none or one that has a name of its own.
    std::string placeWord;
    const Person* placePerson = nullptr;  ///< "near Otto"
    std::optional<platform::Date> until;
};

/// Understands questions: by the templates of their language, else of English, and the contacts. It needs no network
/// and guesses nothing: a reading counts only if all of it can be told. Any thread.
class Understanding {
  public:
    /// What can be said before anybody else is asked: `answer` without its sentence's further words.
    struct NotUnderstood {};
    struct UnknownPerson {
        Meaning meaning;
        std::string name;
        std::vector<const Person*> near;
    };
    struct Ambiguous {
        Meaning meaning;
        std::string name;
        std::vector<const Person*> people;
    };
    /// A moment that the words do not name.
    struct UnknownMoment {
        Meaning meaning;
    };
    using Result = std::variant<Understood, NotUnderstood, UnknownPerson, Ambiguous, UnknownMoment>;

    /// All outlive this. `english`: what is tried second; may be the language itself.
    Understanding(const Language& language, const Language& english, const People& people)
        : language_(language), english_(english), people_(people) {}

    Result understand(const Question& question) const;

  private:
    Result understandIn(const Language& language, const Question& question) const;
    Result resolved(const Language& language, const Question& question, const Meaning& meaning) const;

    const Language& language_;
    const Language& english_;
    const People& people_;
};

}  // namespace ktr::ask
