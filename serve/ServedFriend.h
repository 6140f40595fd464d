#pragma once

#include <optional>
#include <string>
#include <vector>

namespace ktr::serve {

/// Where a friend is at a moment.
struct Waypoint {
    double at = 0.0;  ///< seconds after the service's start
    double latitude = 0.0;
    double longitude = 0.0;
    double accuracy = 12.0;  ///< metres
    std::optional<std::string> street, city, stateCode, label;
    bool hidden = false;  ///< from here on nobody is told where the friend is
    bool operator==(const Waypoint&) const = default;
};

/// Somebody whom the development service knows, and where that person goes.
struct ServedFriend {
    std::string fullName, firstName, lastName;
    std::string identifier;  ///< the assistant's; empty: none
    std::vector<std::string> emails, phones;
    /// By ascending time; empty: never found.
    std::vector<Waypoint> track;
    /// The track begins anew after its last waypoint; else the friend stays there.
    bool repeats = true;
    /// Seconds after the start until the friend is found.
    double locatedAfter = 0.0;
    /// The friend does not share a location: the service reports entry status 411.
    bool hidden = false;

    /// Between two waypoints in proportion to the time; accuracy and address are those of the waypoint last passed.
    /// None while the friend is not found or a waypoint hides them.
    std::optional<Waypoint> placeAt(double seconds) const;
    /// Whether the friend hides then: always, or since the waypoint last passed.
    bool hidesAt(double seconds) const;
    /// E-mail addresses regardless of case, phone numbers by their digits and "+".
    bool answersTo(const std::string& handle) const;
    /// The first e-mail address, else the first phone number; empty without either.
    std::string handle() const;

  private:
    /// Of the track, which is not empty.
    double momentOf(double seconds) const;
};

/// What a friends file says.
struct FriendsFile {
    double intervalSeconds = 10.0;  ///< between two answers
    double timeoutSeconds = 600.0;  ///< after which a snippet stops asking
    /// The account's owner, without a track: the service learns from commands where that is.
    ServedFriend user = defaultUser();
    std::vector<ServedFriend> friends;

    static ServedFriend defaultUser();
};

}  // namespace ktr::serve
