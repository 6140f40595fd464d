#pragma once

#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "server/rules/Visibility.h"

namespace ktr::server {

/// A friend as a phone is told of them.
struct PhoneFriend {
    std::string name;
    Seen seen;
};

/// Words the answer to an OwnTracks post: friends as an array of messages. A single message that the app does not
/// expect costs it the whole array: only cards and locations go out, each checked before it is written, and never a
/// transition. Any thread.
class PhoneAnswer {
  public:
    /// A name as the identity under which the apps keep a friend; the apps show it before a card has come.
    static platform::Value::Array messages(const std::vector<PhoneFriend>& friends, bool withCards);
    /// What the cards of these friends say, as a short text that changes with them.
    static std::string cardsHash(const std::vector<PhoneFriend>& friends);
    /// Whether both apps take such a message: a whole time after 1970, a place on earth, a name, nothing null.
    static bool isSound(const platform::Dictionary& message);
};

}  // namespace ktr::server
