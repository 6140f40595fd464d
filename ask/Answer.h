#pragma once

#include <optional>
#include <string>
#include <vector>

#include "ask/Meaning.h"
#include "platform/base/Value.h"

namespace ktr::ask {

/// What became of a question. Each has a sentence of its own.
enum class Outcome {
    Found,          ///< answered, or done
    NotSeen,        ///< nobody of those asked for can be seen, whatever the reason
    Ambiguous,      ///< several friends have that name
    UnknownPerson,  ///< none of the contacts has that name
    Hidden,         ///< the user is hidden: about the user alone
    Unreachable,    ///< the service gave no answer that can be used
    NotSignedIn,    ///< there is no account, or the service does not know it
    NotUnderstood,
    Locked,   ///< the computer is
    Refused,  ///< the asker may not have this changed from here
};

/// Somebody to choose.
struct Choice {
    std::string name;
    std::string handle;
    /// The question that means this one; to be asked in the place of the one that was asked.
    std::string question;
};

/// What can be done about an answer.
struct Action {
    enum class Kind { None, ChooseOne, DidYouMean, SignIn, TryAgain, Unlock, AskOtherwise, AskToShare };
    Kind kind = Kind::None;
    std::string label;  ///< in the answer's language; empty for none
};

/// One honest answer. The host makes the picture of the snippet.
struct Answer {
    Outcome outcome = Outcome::NotUnderstood;
    std::optional<Meaning> meaning;  ///< none: not understood
    std::string sentence;            ///< never empty
    /// A snippet in the form of a scenario (docs/scenario-format.md); null where there is nothing to show.
    platform::Value snippet;
    std::vector<Choice> choices;           ///< at most 50
    std::vector<std::string> suggestions;  ///< questions that can be asked instead, at most three
    /// Those who were asked about and cannot be seen, whatever the reason; at most five. Their question asks them to
    /// share.
    std::vector<Choice> unseen;
    Action action;
    std::optional<double> ageSeconds;  ///< of the oldest place that the sentence names
};

/// "found", "notSeen", ...: as --json writes it.
const char* nameOf(Outcome outcome);
const char* nameOf(Action::Kind kind);
/// 0 for what is found, else 10 to 18: what a program that asks ends with.
int exitCodeOf(Outcome outcome);
/// The answer as one object: outcome, sentence, and of the others what there is.
platform::Dictionary objectOf(const Answer& answer);

}  // namespace ktr::ask
