#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "serve/Fault.h"
#include "serve/MadeUpPeople.h"
#include "serve/ServedFriend.h"
#include "serve/SharingState.h"
#include "server/http/HttpRequest.h"

namespace ktr::serve {

/// A moment as the development service sees it.
struct ServiceMoment {
    double seconds = 0.0;                ///< since the service's start: what the tracks count
    double millisecondsSince1970 = 0.0;  ///< what the answers carry

    std::int64_t wholeSeconds() const;  ///< since 1970
};

/// What the development service has beyond a service of one's own: people who are made up, the names of the places on
/// their tracks, and answers that go wrong on purpose (docs/service-protocol.md). Any thread.
class LocationService {
  public:
    /// `now`: seconds since 1970. `personId` and `token` are the account's.
    LocationService(FriendsFile file, const std::string& personId, const std::string& token, std::int64_t now);

    const FriendsFile& file() const { return file_; }
    const MadeUpPeople& people() const { return people_; }
    SharingState& sharing() const { return *sharing_; }

    /// What the phones of those who are asked for send at this moment, as it reaches the service: of those who are
    /// found. Whoever hides from now on, or no longer, does so in the service first.
    std::vector<server::HttpRequest> posts(const std::vector<std::string>& handles, const ServiceMoment& moment) const;
    /// The same of everybody whose coming or going the user wants to be told: their phones post by themselves.
    std::vector<server::HttpRequest> watchedPosts(const ServiceMoment& moment) const;
    /// Adds to the service's answer to a get-locations command what the friends file says beyond positions, and what
    /// the fault asks for.
    void completeLocations(platform::Dictionary& answer, const ServiceMoment& moment, const Fault& fault) const;
    /// The same for the answer to a command that shows or hides the user, which it also notes.
    void completeSharing(platform::Dictionary& answer, const platform::Dictionary& request, const ServiceMoment& moment,
                         const Fault& fault) const;

    /// The answer to a wish about the user's own sharing, which the service has done, and which is noted.
    void completeWish(platform::Dictionary& answer, const platform::Dictionary& request) const;

    /// The place with the address of what is near it on somebody's track.
    Waypoint placeAt(double latitude, double longitude) const;
    /// Metres along the geodesic.
    static double distance(double latitude, double longitude, const Waypoint& place);

  private:
    std::vector<server::HttpRequest> postsOf(std::vector<std::size_t> friends, const ServiceMoment& moment) const;
    const ServedFriend* friendWith(const std::string& handle) const;
    /// None: the friend has none.
    std::optional<platform::Dictionary> entryOf(const std::string& handle, const platform::Value* given,
                                                const ServiceMoment& moment, const Fault& fault) const;
    void completeContext(platform::Dictionary& answer, const Fault& fault) const;

    FriendsFile file_;
    MadeUpPeople people_;
    std::unique_ptr<SharingState> sharing_;
};

}  // namespace ktr::serve
