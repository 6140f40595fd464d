#include "serve/LocationService.h"

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>

#include "server/answers/CommandRequest.h"

namespace ktr::serve {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr int kPartial = 416;
constexpr int kNotReported = 411;
/// How near to a requested place counts as being there, metres.
constexpr double kAtPlace = 150.0;

/// How near to a street's waypoint an address has that street, and to a town's that town, metres.
constexpr double kInStreet = 75.0;
constexpr double kInTown = 10000.0;

void setWhenPresent(Dictionary& dictionary, const char* name, const std::optional<std::string>& text) {
    if (text) {
        dictionary.set(name, *text);
    }
}

Value locationOf(const Waypoint& place, double millisecondsSince1970) {
    Dictionary address;
    setWhenPresent(address, "locality", place.city);
    setWhenPresent(address, "stateCode", place.stateCode);
    Dictionary location{{"latitude", place.latitude},
                        {"longitude", place.longitude},
                        {"horizontalAccuracy", place.accuracy},
                        {"timestamp", std::floor(millisecondsSince1970)}};
    setWhenPresent(location, "streetAddress", place.street);
    location.set("address", address.empty() ? Value() : Value(address));
    location.set("labels", place.label ? Value(Value::Array{Dictionary{{"label", *place.label}}}) : Value());
    return location;
}

/// Whole centimetres, as decimal text.
std::string metresText(double metres) {
    return Value(std::round(metres * 100.0) / 100.0).description();
}

}  // namespace

double LocationService::distance(double latitude, double longitude, const Waypoint& place) {
    double metres = 0.0;
    GeographicLib::Geodesic::WGS84().Inverse(latitude, longitude, place.latitude, place.longitude, metres);
    return metres;
}

std::vector<LocationService::Asked> LocationService::friendsAskedFor(const std::vector<std::string>& handles) const {
    std::vector<Asked> asked;
    for (const std::string& handle : handles) {
        const auto person = std::find_if(file_.friends.begin(), file_.friends.end(),
                                         [&](const auto& one) { return one.answersTo(handle); });
        if (person == file_.friends.end()) {
            continue;
        }
        const auto before =
            std::find_if(asked.begin(), asked.end(), [&](const Asked& one) { return one.person == &*person; });
        if (before == asked.end()) {
            asked.push_back({handle, &*person});
        } else if (before->handle.find('@') == std::string::npos && handle.find('@') != std::string::npos) {
            // One entry a friend; an e-mail address comes back as it was asked for, a phone number may not.
            before->handle = handle;
        }
    }
    return asked;
}

std::optional<Dictionary> LocationService::getLocations(const Dictionary& request, const ServiceMoment& moment,
                                                        const Fault& fault, std::string& complaint) const {
    const auto asks = server::LocationsRequest::read(request, complaint);
    if (!asks) {
        return std::nullopt;
    }
    std::vector<Asked> asked = friendsAskedFor(asks->handles);
    const int statusCode = fault.statusCode.value_or(200);
    if (statusCode == kPartial) {
        asked.resize((asked.size() + 1) / 2);
    }

    Dictionary locations;
    Value::Array order;
    for (const auto& [handle, person] : asked) {
        const auto place = person->placeAt(moment.seconds);
        const bool faulty = fault.entryStatus && (fault.entry.empty() || person->answersTo(fault.entry));
        Dictionary entry{{"status", faulty ? *fault.entryStatus : person->hidden ? kNotReported : 200}};
        entry.set("location", place ? locationOf(*place, moment.millisecondsSince1970) : Value());
        if (place && asks->mine) {
            entry.set("distanceInMeters", metresText(distance(asks->mine->latitude, asks->mine->longitude, *place)));
        }
        if (place && asks->wanted) {
            entry.set("match", distance(asks->wanted->latitude, asks->wanted->longitude, *place) <= kAtPlace);
        }
        locations.set(handle, entry);
        order.emplace_back(handle);
    }
    Dictionary context = serverContext(fault);
    setWhenPresent(context, "clientId", asks->clientId);
    return Dictionary{
        {"statusCode", statusCode}, {"serverContext", context}, {"locations", locations}, {"emails", order}};
}

Dictionary LocationService::serverContext(const Fault& fault) const {
    return {{"minCallbackIntervalInMS", std::round(fault.intervalSeconds.value_or(file_.intervalSeconds) * 1000.0)},
            {"callbackTimeoutIntervalInMS", std::round(file_.timeoutSeconds * 1000.0)}};
}

Waypoint LocationService::placeAt(double latitude, double longitude) const {
    Waypoint place;
    place.latitude = latitude;
    place.longitude = longitude;
    const Waypoint* nearest = nullptr;
    double least = kInTown;
    for (const ServedFriend& person : file_.friends) {
        for (const Waypoint& waypoint : person.track) {
            const double metres = distance(latitude, longitude, waypoint);
            if (metres <= least) {
                least = metres;
                nearest = &waypoint;
            }
        }
    }
    if (nearest != nullptr) {
        place.city = nearest->city;
        place.stateCode = nearest->stateCode;
        if (least <= kInStreet) {
            place.street = nearest->street;
        }
    }
    return place;
}

std::optional<Dictionary> LocationService::showHideLocation(const Dictionary& request, const ServiceMoment& moment,
                                                            const Fault& fault, std::string& complaint) const {
    const auto asks = server::SharingRequest::read(request, complaint);
    if (!asks) {
        return std::nullopt;
    }
    if (fault.status < 300) {
        std::optional<SharingState::Position> position;
        if (asks->place) {
            position = SharingState::Position{asks->place->latitude, asks->place->longitude};
            position->accuracy = asks->place->accuracy.value_or(position->accuracy);
        }
        sharing_->command(asks->hides, position);
    }
    const auto known = sharing_->now();
    Dictionary myInfo;
    if (!file_.user.emails.empty()) {
        myInfo.set("preferredEmail", file_.user.emails.front());
    }
    myInfo.set("hidden", known.hidden);
    Value location;
    if (!known.hidden && known.position) {
        Waypoint place = placeAt(known.position->latitude, known.position->longitude);
        place.accuracy = known.position->accuracy;
        location = locationOf(place, moment.millisecondsSince1970);
    }
    myInfo.set("location", location);
    return Dictionary{
        {"statusCode", fault.statusCode.value_or(200)}, {"serverContext", serverContext(fault)}, {"myInfo", myInfo}};
}

}  // namespace ktr::serve
