#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "server/fences/Fence.h"
#include "server/rules/Visibility.h"
#include "server/store/Records.h"

namespace ktr::server {

/// A friend as a phone is told of them.
struct PhoneFriend {
    std::string name;
    std::optional<Seen> seen;  ///< none: only the card, if there is one
    bool withCard = false;
    std::string face = {};   ///< the bytes of a picture for the card; empty: none
    std::string title = {};  ///< what the card calls them; empty: the name
};

/// Words the answer to an OwnTracks post: friends as an array of messages. A single message that the app does not
/// expect costs it the whole array: only cards and locations go out, and what one of the apps takes to that one, each
/// checked before it is written. Any thread.
class PhoneAnswer {
  public:
    /// A name as the identity under which the apps keep a friend; the apps show it before a card has come.
    static platform::Value::Array messages(const std::vector<PhoneFriend>& friends);
    /// Who came and went, for the one app that shows it: the other makes a friend without a name of it.
    static platform::Value::Array transitions(const std::vector<FenceEvent>& events);
    static bool showsTransitions(const std::string& userAgent);
    /// What makes a phone say where it is now: for the one app that does so unless its owner forbade it there. The
    /// other takes no such message from a server without its owner's leave.
    static platform::Dictionary reportNow();
    static bool reportsWhenTold(const std::string& userAgent);
    /// What somebody's card says, as a short text that changes with it.
    static std::string cardHash(const std::string& name, const std::string& faceHash);
    /// Whether a phone is to be told: never before, something else, a week ago, or in the answer to this very post,
    /// which it sends again since that answer did not arrive. `post`: the time of the post's fix, 0 without one.
    static bool isCardDue(const SentCard& sent, const std::string& hash, std::int64_t now, std::int64_t post);
    /// Whether both apps take such a message: a whole time after 1970, a place on earth, a name, nothing null.
    static bool isSound(const platform::Dictionary& message);
};

}  // namespace ktr::server
