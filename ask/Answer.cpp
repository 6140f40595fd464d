#include "ask/Answer.h"

#include <array>

namespace ktr::ask {

using platform::Dictionary;
using platform::Value;

const char* nameOf(Outcome outcome) {
    constexpr std::array<const char*, 10> kNames{"found",       "notSeen",     "ambiguous",     "unknownPerson", "hidden",
                                                 "unreachable", "notSignedIn", "notUnderstood", "locked",        "refused"};
    return kNames.at(static_cast<std::size_t>(outcome));
}

const char* nameOf(Action::Kind kind) {
    constexpr std::array<const char*, 7> kNames{"none", "chooseOne", "didYouMean", "signIn", "tryAgain", "unlock", "askOtherwise"};
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
    if (!answer.choices.empty()) {
        Value::Array choices;
        for (const Choice& choice : answer.choices) {
            choices.emplace_back(
                Dictionary{{"name", choice.name}, {"handle", choice.handle}, {"question", choice.question}});
        }
        object.set("choices", choices);
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
