#include "server/answers/LocationAnswers.h"

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>

#include "platform/base/Json.h"

namespace ktr::server {

using platform::Dictionary;
using platform::Value;

namespace {

/// How near to a requested place counts as being there, metres.
constexpr double kAtPlace = 150.0;

double distance(const CommandPlace& place, const Seen& seen) {
    double metres = 0.0;
    GeographicLib::Geodesic::WGS84().Inverse(place.latitude, place.longitude, seen.latitude, seen.longitude, metres);
    return metres;
}

/// Clients show the first label as it stands, or else the town.
void addName(Dictionary& location, const PlaceName& name) {
    if (!name.street.empty()) {
        location.set("streetAddress", name.street);
    }
    if (!name.town.empty()) {
        location.set("address", Dictionary{{"locality", name.town}});
    }
    if (!name.words.empty()) {
        Dictionary label{{"label", name.words}};
        // "near Exeter, 40 km": whoever makes a sentence of it adds no "at".
        if (name.street.empty()) {
            label.set("phrase", true);
        }
        location.set("labels", Value::Array{label});
    }
}

Dictionary locationOf(const Seen& seen, const PlaceName& name) {
    Dictionary location{{"latitude", seen.latitude}, {"longitude", seen.longitude}};
    if (seen.accuracy) {
        location.set("horizontalAccuracy", *seen.accuracy);
    }
    location.set("timestamp", seen.time * 1000);
    if (!seen.place.empty()) {
        // Clients word the sorts of places that they know, and take the first label.
        Value::Array labels;
        if (!seen.label.empty()) {
            labels.emplace_back(Dictionary{{"label", "_$!<" + seen.label + ">!$_"}});
        }
        labels.emplace_back(Dictionary{{"label", seen.place}});
        location.set("labels", std::move(labels));
    } else {
        addName(location, name);
    }
    return location;
}

Dictionary entryOf(const AskedFriend& one, const LocationsRequest& request) {
    const Seen& seen = *one.seen;
    Dictionary location = locationOf(seen, one.name);
    // Absent it may not.
    if (one.aloud) {
        location.set("aloud", true);
    }
    Dictionary entry{{"status", 200}, {"location", location}};
    if (request.mine) {
        // Whole centimetres, as decimal text.
        entry.set("distanceInMeters", Value(std::round(distance(*request.mine, seen) * 100.0) / 100.0).description());
    }
    if (request.wanted) {
        entry.set("match", distance(*request.wanted, seen) <= kAtPlace);
    }
    return entry;
}

Dictionary serverContext(double interval) {
    return {{"minCallbackIntervalInMS", interval * 1000.0},
            {"callbackTimeoutIntervalInMS", LocationAnswers::kTimeout * 1000.0}};
}

bool isEmail(const std::string& handle) {
    return handle.find('@') != std::string::npos;
}

}  // namespace

std::string LocationAnswers::said(const AskedFriend& friend_) {
    if (!friend_.seen) {
        return "";
    }
    return platform::writeJson(locationOf(*friend_.seen, {})) + (friend_.aloud ? "aloud" : "");
}

Dictionary LocationAnswers::locations(const LocationsRequest& request, std::vector<AskedFriend> friends,
                                      double interval) {
    const bool partly = request.handles.size() > kMostHandles;
    std::vector<AskedFriend> found;
    Value::Array rest;
    Dictionary asked;
    for (AskedFriend& one : friends) {
        if (one.askedSince != 0) {
            asked.set(one.handle, one.askedSince * 1000);
        }
        if (!one.seen) {
            rest.emplace_back(one.handle);
            continue;
        }
        const auto before = std::find_if(found.begin(), found.end(),
                                         [&](const AskedFriend& other) { return other.person == one.person; });
        if (before == found.end()) {
            found.push_back(std::move(one));
        } else if (!isEmail(before->handle) && isEmail(one.handle)) {
            // An e-mail address comes back as it was asked for; a phone number may not.
            before->handle = one.handle;
        }
    }
    Dictionary locations;
    Value::Array order;
    for (const AskedFriend& one : found) {
        locations.set(one.handle, entryOf(one, request));
        order.emplace_back(one.handle);
    }
    order.insert(order.end(), rest.begin(), rest.end());
    Dictionary context = serverContext(interval);
    if (request.clientId) {
        context.set("clientId", *request.clientId);
    }
    Dictionary answer{
        {"statusCode", partly ? 416 : 200}, {"serverContext", context}, {"locations", locations}, {"emails", order}};
    if (asked.size() > 0) {
        answer.set("asked", asked);
    }
    return answer;
}

Dictionary LocationAnswers::sharing(bool hidden, const std::string& preferredHandle,
                                    const std::optional<CommandPlace>& place, const PlaceName& name, std::int64_t now) {
    Dictionary myInfo;
    if (!preferredHandle.empty()) {
        myInfo.set("preferredEmail", preferredHandle);
    }
    myInfo.set("hidden", hidden);
    myInfo.set("location", hidden || !place
                               ? Value()
                               : Value(locationOf({place->latitude, place->longitude, place->accuracy, now}, name)));
    return {{"statusCode", 200}, {"serverContext", serverContext(kInterval)}, {"myInfo", myInfo}};
}

}  // namespace ktr::server
