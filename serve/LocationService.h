#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/base/Value.h"
#include "serve/Fault.h"
#include "serve/ServedFriend.h"
#include "serve/SharingState.h"

namespace ktr::serve {

/// A moment as the development service sees it.
struct ServiceMoment {
    double seconds = 0.0;                ///< since the service's start: what the tracks count
    double millisecondsSince1970 = 0.0;  ///< what the answers carry
};

/// What the development service answers, without any network: docs/service-protocol.md. It remembers what commands said
/// of the user's own sharing. Any thread.
class LocationService {
  public:
    explicit LocationService(FriendsFile file) : file_(std::move(file)), sharing_(std::make_unique<SharingState>()) {}

    /// The answer to a get-locations request. None, with the reason in `complaint`, for a request that is not one.
    std::optional<platform::Dictionary> getLocations(const platform::Dictionary& request, const ServiceMoment& moment,
                                                     const Fault& fault, std::string& complaint) const;
    /// The answer to a command that shows or hides the user, in the same way.
    std::optional<platform::Dictionary> showHideLocation(const platform::Dictionary& request,
                                                         const ServiceMoment& moment, const Fault& fault,
                                                         std::string& complaint) const;
    const FriendsFile& file() const { return file_; }
    /// Locks itself: commands come on several threads.
    SharingState& sharing() const { return *sharing_; }
    /// The place with the address of what is near it on somebody's track.
    Waypoint placeAt(double latitude, double longitude) const;

    /// Metres along the geodesic.
    static double distance(double latitude, double longitude, const Waypoint& place);

  private:
    struct Asked {
        std::string handle;  ///< as it was asked for
        const ServedFriend* person;
    };
    std::vector<Asked> friendsAskedFor(const std::vector<std::string>& handles) const;
    platform::Dictionary serverContext(const Fault& fault) const;

    FriendsFile file_;
    std::unique_ptr<SharingState> sharing_;
};

}  // namespace ktr::serve
