#pragma once

#include <string>
#include <vector>

#include "app/serve/LocationService.h"

namespace ktr::app {

/// Understands a question about friends and answers with a turn of the conversation: a scenario
/// (docs/scenario-format.md) with "question", "sentence" and, when the question was understood, "snippet". Any thread.
class AssistantAnswers {
  public:
    explicit AssistantAnswers(const LocationService& service) : service_(service) {}

    platform::Dictionary answer(const std::string& question, const ServiceMoment& moment) const;

  private:
    std::vector<const ServedFriend*> friendsNamed(const std::string& question) const;
    platform::Value snippet(const std::vector<const ServedFriend*>& friends, const char* proximity,
                            const ServiceMoment& moment) const;
    std::string sentence(const std::vector<const ServedFriend*>& friends, const ServiceMoment& moment) const;
    std::string help() const;

    const LocationService& service_;
};

}  // namespace ktr::app
