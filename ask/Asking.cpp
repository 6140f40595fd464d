#include "ask/Asking.h"

#include <algorithm>
#include <utility>

#include "ask/FoldedText.h"

namespace ktr::ask {

namespace {

/// Of people who share a name: more than anybody looks through.
constexpr std::size_t kMostChoices = 50;
constexpr std::size_t kMostSuggestions = 3;

std::string replaced(std::string text, const std::string& what, const std::string& with) {
    if (const auto at = text.find(what); at != std::string::npos) {
        text.replace(at, what.size(), with);
    }
    return text;
}

}  // namespace

Answer Asking::answer(Outcome outcome, std::string sentence) const {
    Answer answer;
    answer.outcome = outcome;
    answer.sentence = std::move(sentence);
    if (outcome != Outcome::NotUnderstood) {
        answer.meaning = understood.meaning;
    }
    return answer;
}

Answer Asking::failed(ServiceReply::Failure failure) const {
    const bool isSignedOut = failure == ServiceReply::Failure::NotSignedIn;
    Answer failed = answer(isSignedOut ? Outcome::NotSignedIn : Outcome::Unreachable,
                           sentences().text(isSignedOut ? "notSignedIn" : "unreachable"));
    failed.action = {isSignedOut ? Action::Kind::SignIn : Action::Kind::TryAgain,
                     sentences().text(isSignedOut ? "signIn" : "tryAgain")};
    return failed;
}

Answer Asking::notUnderstood(const std::string& key) const {
    Answer answer = this->answer(Outcome::NotUnderstood, sentences().text(key));
    std::string name;
    for (const Person& person : people->all()) {
        if (name.empty() && !person.handle().empty()) {
            name = person.firstName.empty() ? person.shownName() : person.firstName;
        }
    }
    for (const std::string& suggestion : language->suggestions()) {
        const bool wantsName = suggestion.find("{name}") != std::string::npos;
        if (answer.suggestions.size() < kMostSuggestions && !(wantsName && name.empty())) {
            answer.suggestions.push_back(replaced(suggestion, "{name}", name));
        }
    }
    answer.action = {Action::Kind::AskOtherwise, sentences().text("youCouldAsk")};
    return answer;
}

void Asking::addChoices(Answer& answer, const std::string& said, const std::vector<const Person*>& offered) const {
    for (const Person* person : offered) {
        if (answer.choices.size() == kMostChoices) {
            return;
        }
        answer.choices.push_back(
            {person->shownName(), person->handle(),
             replaced(question.text, said, person->handle().empty() ? person->shownName() : person->handle())});
    }
}

Answer Asking::unknownPerson(const Understanding::UnknownPerson& unknown) const {
    std::vector<std::string> near;
    for (const Person* person : unknown.near) {
        near.push_back(person->shownName());
    }
    Answer answer = this->answer(Outcome::UnknownPerson,
                                 sentences().text(near.empty() ? "unknownPerson" : "unknownPersonNear",
                                                  {{"name", unknown.name}, {"choices", sentences().list(near, true)}}));
    answer.meaning = unknown.meaning;
    addChoices(answer, unknown.name, unknown.near);
    if (!near.empty()) {
        answer.action = {Action::Kind::DidYouMean, near.front()};
    } else {
        answer.action = {Action::Kind::AskOtherwise, sentences().text("seeAll")};
    }
    return answer;
}

Answer Asking::ambiguous(const Understanding::Ambiguous& several) const {
    Answer answer = this->answer(Outcome::Ambiguous, sentences().text("ambiguous", {{"name", several.name}}));
    answer.meaning = several.meaning;
    addChoices(answer, several.name, several.people);
    answer.action = {Action::Kind::ChooseOne, sentences().text("chooseOne")};
    return answer;
}

Answer Asking::locked() const {
    Answer answer = this->answer(Outcome::Locked, sentences().text("locked"));
    answer.meaning.reset();
    answer.action = {Action::Kind::Unlock, sentences().text("unlock")};
    return answer;
}

Answer Asking::refused() const {
    return answer(Outcome::Refused, sentences().text("refused"));
}

}  // namespace ktr::ask
