#include "serve/ServedFriend.h"

#include <algorithm>
#include <cmath>

#include "server/store/Store.h"

namespace ktr::serve {

namespace {

auto waypointAfter(const std::vector<Waypoint>& track, double moment) {
    return std::upper_bound(track.begin(), track.end(), moment,
                            [](double at, const Waypoint& waypoint) { return at < waypoint.at; });
}

}  // namespace

double ServedFriend::momentOf(double seconds) const {
    const double end = track.back().at;
    return repeats && end > 0.0 && seconds > end ? std::fmod(seconds, end) : seconds;
}

bool ServedFriend::hidesAt(double seconds) const {
    if (hidden || track.empty()) {
        return hidden;
    }
    const auto next = waypointAfter(track, momentOf(seconds));
    return (next == track.begin() ? next : next - 1)->hidden;
}

std::optional<Waypoint> ServedFriend::placeAt(double seconds) const {
    if (track.empty() || seconds < locatedAfter || hidesAt(seconds)) {
        return std::nullopt;
    }
    const double moment = momentOf(seconds);
    const auto next = waypointAfter(track, moment);
    Waypoint place = next == track.begin() ? *next : *(next - 1);
    if (next != track.begin() && next != track.end()) {
        const double part = (moment - place.at) / (next->at - place.at);
        place.latitude += part * (next->latitude - place.latitude);
        place.longitude += part * (next->longitude - place.longitude);
    }
    return place;
}

std::string ServedFriend::handle() const {
    return !emails.empty() ? emails.front() : !phones.empty() ? phones.front() : "";
}

ServedFriend FriendsFile::defaultUser() {
    ServedFriend user;
    user.fullName = "Mara Lind";
    user.firstName = "Mara";
    user.lastName = "Lind";
    user.emails = {"mara.lind@harbour.example"};
    return user;
}

bool ServedFriend::answersTo(const std::string& handle) const {
    using server::Store;
    const std::string wanted = Store::normalisedHandle(handle);
    const auto same = [&](const std::string& own) { return Store::normalisedHandle(own) == wanted; };
    return !wanted.empty() &&
           (std::any_of(emails.begin(), emails.end(), same) || std::any_of(phones.begin(), phones.end(), same));
}

}  // namespace ktr::serve
