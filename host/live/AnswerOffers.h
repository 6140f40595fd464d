#pragma once

#include <functional>
#include <string>

#include "ask/Answer.h"
#include "host/Host.h"
#include "host/conversation/Offer.h"

namespace ktr::host {

/// What can be done about an answer, as the conversation offers it: a button for each thing that somebody does. Main
/// thread.
class AnswerOffers {
  public:
    /// What the offers do when they are pressed. What is not there is not offered.
    struct Does {
        std::function<void(const std::string& question)> ask;     ///< another question
        std::function<void(const std::string& question)> choose;  ///< the same one, by somebody's choice
        std::function<void()> again;                              ///< the same one
        std::function<void()> signIn;
        std::function<void()> showFriends;
        std::function<void(const std::string& url)> open;
    };

    static Offers of(const ask::Answer& answer, const Host& host, const Does& does);

  private:
    static void addUnseen(const ask::Answer& answer, const Host& host, const Does& does, Offers& offers);
};

}  // namespace ktr::host
