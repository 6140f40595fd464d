#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "server/answers/CommandRequest.h"
#include "server/names/PlaceNames.h"
#include "server/rules/Visibility.h"

namespace ktr::server {

/// Somebody who was asked for, and what the one who asks may see of them.
struct AskedFriend {
    std::string handle;       ///< as it was asked for
    std::int64_t person = 0;  ///< 0: nobody has this handle
    std::optional<Seen> seen;
    PlaceName name = {};  ///< of where they are seen; of a place that its owner named nothing
    bool aloud = false;   ///< whether that may be said aloud
    /// Since when a newer fix is asked for, seconds since 1970; 0: it is not. The same for whoever is not seen.
    std::int64_t askedSince = 0;
};

/// Words the protocol's answers, of what `Visibility` lets through and of nothing else. Any thread.
class LocationAnswers {
  public:
    /// Seconds between two answers, and after which a client stops asking.
    static constexpr double kInterval = 30.0;
    static constexpr double kTimeout = 600.0;
    /// How many handles of one command are looked up; with more the answer says that it is a part (416), whoever they
    /// are.
    static constexpr std::size_t kMostHandles = 1000;

    /// The answer to a get-locations command. Friends who are seen come first, one handle each, the e-mail address if
    /// one was asked for. All others are listed as they were asked for, without an entry, whatever the reason.
    /// `friends` are as many as were asked for.
    static platform::Dictionary locations(const LocationsRequest& request, std::vector<AskedFriend> friends,
                                          double interval = kInterval);
    /// What is said of where a friend is, as a text that changes with it.
    static std::string said(const AskedFriend& friend_);

    /// The answer to a command about the user's own sharing. `place` serves the answer and is kept nowhere.
    static platform::Dictionary sharing(bool hidden, const std::string& preferredHandle,
                                        const std::optional<CommandPlace>& place, const PlaceName& name,
                                        std::int64_t now);
};

}  // namespace ktr::server
