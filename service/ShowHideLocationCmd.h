#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/location/PlatformLocation.h"
#include "service/KTRBaseCmd.h"

namespace ktr {

/// Sets whether friends can see where the user is, tells the service where that is, and reads back what the service
/// knows of the user. Main thread.
class ShowHideLocationCmd : public KTRBaseCmd {
  public:
    std::string path() const override;
    /// "clientContext", in a copy to which the user's position is added as "location", and "prefs" with
    /// "hideLocation", "Yes" or "No". A position that is not known is sent as one at 0, 0.
    platform::Dictionary jsonBodyDictionary() override;
    /// Two items, made anew at every call: the raw answer, and the user's own record, made of the answer's "myInfo"
    /// (absent: nothing but the handle is known) and its "preferredEmail". Sets `contextIdentifierURL`, with that
    /// address as "preferredEmail". Empty without an answer.
    std::optional<ServiceResult> result() override;

    std::optional<platform::Dictionary> currentLocationDictionary() const;

    /// True: the user is to be hidden.
    bool hideLocation() const { return hideLocation_; }
    void setHideLocation(bool hide) { hideLocation_ = hide; }
    /// The user's own position; may be none.
    const std::shared_ptr<platform::PlatformLocation>& currentLocation() const { return currentLocation_; }
    void setCurrentLocation(std::shared_ptr<platform::PlatformLocation> location) {
        currentLocation_ = std::move(location);
    }

  private:
    bool hideLocation_ = false;
    std::shared_ptr<platform::PlatformLocation> currentLocation_;
};

}  // namespace ktr
