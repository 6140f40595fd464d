#pragma once

#include <string>
#include <vector>

#include "ask/Asking.h"
#include "ask/Sight.h"

namespace ktr::ask {

/// Answers to questions about where friends are, from what the service said: of those who are asked for, and what it
/// tells of nobody is never told apart from what it does not know. Any thread.
class WhereAnswers {
  public:
    /// Metres around a place that count as near it, and within which somebody is at it.
    static constexpr double kNear = 5000.0;
    static constexpr double kAt = 150.0;
    /// A place with a position: of the user's own, or of the question.
    struct Place {
        std::string name;
        double latitude = 0.0;
        double longitude = 0.0;
    };

    /// `sights`: of those whom the question is about. `answer`: the service's, whose context goes into the snippet.
    WhereAnswers(const Asking& asking, std::vector<Sight> sights, const platform::Dictionary& answer);

    /// Those whom the service has to be asked for.
    static std::vector<const Person*> asked(const Understood& understood, const People& people);
    /// `ownPlaces`: the user's places, as far as the service names them.
    Answer answer(const std::vector<Place>& ownPlaces) const;

  private:
    Answer whereIs() const;
    Answer whereAll() const;
    Answer howFar() const;
    Answer isAt(const std::vector<Place>& ownPlaces) const;
    Answer near(const std::vector<Place>& ownPlaces) const;

    /// What is said of those whom nobody sees: one sentence each, empty for none.
    std::vector<const Person*> unseen() const;
    std::string unseenSentences() const;
    /// Since when the service asks for a newer place of somebody whose place is not of now; empty where it does not.
    std::string askedSentence() const;
    /// What can be done about those who are not seen: the same for each reason.
    void offerUnseen(Answer& answer) const;
    Answer nobodySeen() const;
    Answer found(std::string sentence, const std::vector<Sight>& sights, bool isList) const;
    std::string nameOf(const Sight& sight) const { return sight.person->shownName(); }
    /// The place that the question means, by its own name, a friend's or the asker's; none: nobody knows it.
    std::optional<Place> place(const std::vector<Place>& ownPlaces) const;

    const Asking& asking_;
    const Sentences sentences_;
    const std::vector<Sight> sights_;
    const platform::Dictionary& answer_;
};

}  // namespace ktr::ask
