#include "ask/Answer.h"

#include <array>
#include <utility>

namespace ktr::ask {

using platform::Dictionary;
using platform::Value;

const char* nameOf(Outcome outcome) {
    constexpr std::array<const char*, 10> kNames{"found",  "notSeen",     "ambiguous",   "unknownPerson",
                                                 "hidden", "unreachable", "notSignedIn", "notUnderstood",
                                                 "locked", "refused"};
    return kNames.at(static_cast<std::size_t>(outcome));
}

const char* nameOf(Action::Kind kind) {
    constexpr std::array<const char*, 8> kNames{"none",     "chooseOne", "didYouMean",   "signIn",
                                                "tryAgain", "unlock",    "askOtherwise", "askToShare"};
    return kNames.at(static_cast<std::size_t>(kind));
}

int exitCodeOf(Outcome outcome) {
    // 0, then 10 to 18 in the order of the outcomes.
    constexpr int kFirst = 10;
    return outcome == Outcome::Found ? 0 : kFirst + static_cast<int>(outcome) - 1;
}

Dictionary objectOf(const Answer& answer) {
    Dictionary object{{"outcome", nameOf(answer.outcome)}, {"sentence", answer.sentence}};
    if (answer.meaning) {
        object.set("wish", nameOf(answer.meaning->wish));
    }
    for (const auto& [name, people] : {std::pair("choices", &answer.choices), std::pair("unseen", &answer.unseen)}) {
        Value::Array listed;
        for (const Choice& choice : *people) {
            listed.emplace_back(
                Dictionary{{"name", choice.name}, {"handle", choice.handle}, {"question", choice.question}});
        }
        if (!listed.empty()) {
            object.set(name, listed);
        }
    }
    if (!answer.suggestions.empty()) {
        object.set("suggestions", Value::Array(answer.suggestions.begin(), answer.suggestions.end()));
    }
    if (answer.action.kind != Action::Kind::None) {
        object.set("action", Dictionary{{"kind", nameOf(answer.action.kind)}, {"label", answer.action.label}});
    }
    if (!answer.snippet.isNull()) {
        object.set("snippet", answer.snippet);
    }
    if (answer.ageSeconds) {
        object.set("age_s", *answer.ageSeconds);
    }
    return object;
}

}  // namespace ktr::ask
