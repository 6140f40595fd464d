#pragma once

#include <optional>
#include <string>
#include <vector>

#include "serve/FenceQuestion.h"
#include "serve/LocationService.h"
#include "serve/QuestionWords.h"
#include "serve/SharingQuestion.h"

namespace ktr::serve {

/// Understands a question about friends, about one's coming or going, and about the user's own sharing, which it
/// changes as it is asked to; answers with a turn of the conversation: a scenario (docs/scenario-format.md) with
/// "question", "sentence" and, when the question was understood, "snippet". Any thread.
class AssistantAnswers {
  public:
    explicit AssistantAnswers(const LocationService& service) : service_(service) {}

    platform::Dictionary answer(const std::string& question, const ServiceMoment& moment) const;

  private:
    std::vector<const ServedFriend*> friendsNamed(const QuestionWords& question) const;
    // Each gives a turn without its question.
    platform::Dictionary sharingAnswer(SharingQuestion::Wish wish, const ServiceMoment& moment) const;
    /// None when it is not asked for.
    std::optional<platform::Dictionary> fenceAnswer(const QuestionWords& question,
                                                    const std::vector<const ServedFriend*>& friends,
                                                    const ServiceMoment& moment) const;
    platform::Dictionary fenceAnswer(const FenceQuestion& question, const ServedFriend& person, const Waypoint& place,
                                     const ServiceMoment& moment) const;
    platform::Dictionary locationsAnswer(const QuestionWords& question, std::vector<const ServedFriend*> friends,
                                         const ServiceMoment& moment) const;
    /// The place that these words mean to a friend; without words, where the friend is.
    std::optional<Waypoint> placeNamed(const QString& words, const ServedFriend& person,
                                       const ServiceMoment& moment) const;
    std::string context() const;
    platform::Value snippet(const std::vector<const ServedFriend*>& friends, const char* proximity,
                            const ServiceMoment& moment) const;
    std::string sentence(const std::vector<const ServedFriend*>& friends, const ServiceMoment& moment) const;
    std::string help() const;

    const LocationService& service_;
};

}  // namespace ktr::serve
