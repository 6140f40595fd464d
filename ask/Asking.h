#pragma once

#include <memory>

#include "ask/Answer.h"
#include "ask/People.h"
#include "ask/Ports.h"
#include "ask/Question.h"
#include "ask/Sentences.h"
#include "ask/Understanding.h"

namespace ktr::ask {

/// A question while it is being answered, with all that its answer stands on. Shared by what waits for the service.
struct Asking {
    Question question;
    std::shared_ptr<const Language> language;  ///< of the answer
    std::shared_ptr<const People> people;
    World world;
    Understood understood;

    Sentences sentences() const { return {*language, question.secondsFromUtc}; }
    /// An answer with its sentence.
    Answer answer(Outcome outcome, std::string sentence) const;
    /// What is said of no one in particular: unreachable, not signed in, locked.
    Answer failed(ServiceReply::Failure failure) const;
    Answer notUnderstood(const std::string& key) const;
    Answer unknownPerson(const Understanding::UnknownPerson& unknown) const;
    Answer ambiguous(const Understanding::Ambiguous& several) const;
    Answer locked() const;
    Answer refused() const;

  private:
    void addChoices(Answer& answer, const std::string& said, const std::vector<const Person*>& offered) const;
};

}  // namespace ktr::ask
