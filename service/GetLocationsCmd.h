#pragma once

#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/assistant/VAPerson.h"
#include "platform/location/PlatformLocation.h"
#include "service/KTRBaseCmd.h"

namespace ktr {

/// Asks the service where a set of friends are now. Main thread.
class GetLocationsCmd : public KTRBaseCmd {
  public:
    using Persons = std::vector<std::shared_ptr<platform::VAPerson>>;

    std::string path() const override;
    /// "clientContext", then "handles" (when `friends` is set), "myLocation", "requestedLocation", "label",
    /// "proximity" and "serverContext" (the client identifier). A position that is not known is sent as one at 0, 0,
    /// deliberately: the service expects both positions in every request.
    platform::Dictionary jsonBodyDictionary() override;
    /// The friends' locations, made anew at every call, in the order of the answer's "emails", or without those in the
    /// order of its "locations". An entry of status 411 is left out; a handle without an entry is not. Sets
    /// `contextIdentifierURL` and `atRequestedLocation`. None without an answer.
    std::optional<ServiceResult> result() override;

    std::optional<platform::Dictionary> currentLocationDictionary() const;
    std::optional<platform::Dictionary> requestedLocationDictionary() const;
    /// The service's handles of all friends in order, with duplicates; none when `friends` is not set.
    std::optional<std::vector<std::string>> allFriendsHandles() const;
    /// The first person with an e-mail address or a number of exactly these bytes, as they were in `setFriends`.
    /// Numbers are compared as the person carries them while they are sent completed, so that a number that comes back
    /// completed may deliberately find nobody.
    std::shared_ptr<platform::VAPerson> friendForHandle(const std::string& handle) const;

    /// Not set: no "handles" are sent. Empty: an empty list is.
    const std::optional<Persons>& friends() const { return friends_; }
    void setFriends(std::optional<Persons> friends);
    /// Kept for callers; not sent.
    const std::vector<std::string>& emails() const { return emails_; }
    void setEmails(std::vector<std::string> emails) { emails_ = std::move(emails); }
    const std::optional<std::string>& proximity() const { return proximity_; }
    void setProximity(std::optional<std::string> proximity) { proximity_ = std::move(proximity); }
    /// The user's own position; may be none.
    std::shared_ptr<platform::PlatformLocation> currentLocation() const { return currentLocation_; }
    void setCurrentLocation(std::shared_ptr<platform::PlatformLocation> location) {
        currentLocation_ = std::move(location);
    }
    /// A place that is asked about; may be none.
    std::shared_ptr<platform::PlatformLocation> requestedLocation() const { return requestedLocation_; }
    void setRequestedLocation(std::shared_ptr<platform::PlatformLocation> location) {
        requestedLocation_ = std::move(location);
    }
    const std::optional<std::string>& requestedLocationLabel() const { return requestedLocationLabel_; }
    void setRequestedLocationLabel(std::optional<std::string> label) { requestedLocationLabel_ = std::move(label); }
    /// Whether the last friend of the answer is at the requested place; none before an answer names a friend.
    const std::optional<bool>& atRequestedLocation() const { return atRequestedLocation_; }
    void setAtRequestedLocation(std::optional<bool> atRequestedLocation) { atRequestedLocation_ = atRequestedLocation; }
    const std::optional<std::string>& clientId() const { return clientId_; }
    void setClientId(std::optional<std::string> clientId) { clientId_ = std::move(clientId); }

  private:
    void readServerContext(const platform::Dictionary& response);
    /// `entry` may be none.
    void appendLocation(const std::string& handle, const platform::Dictionary* entry, ServiceResult& found);

    std::optional<Persons> friends_;
    /// The first person of each address and number.
    std::unordered_map<std::string, std::shared_ptr<platform::VAPerson>> friendsByHandle_;
    std::vector<std::string> emails_;
    std::optional<std::string> proximity_;
    std::shared_ptr<platform::PlatformLocation> currentLocation_;
    std::shared_ptr<platform::PlatformLocation> requestedLocation_;
    std::optional<std::string> requestedLocationLabel_;
    std::optional<bool> atRequestedLocation_;
    std::optional<std::string> clientId_;
};

}  // namespace ktr
