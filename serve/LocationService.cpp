#include "serve/LocationService.h"

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>

#include "documents/FieldReader.h"

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

using Position = SharingState::Position;

/// None without a position; 0/0 is what a client sends that knows none.
std::optional<Position> readPosition(documents::FieldReader& request, const std::string& name) {
    std::optional<Position> position;
    request.object(name, [&](documents::FieldReader& fields) {
        const auto latitude = fields.number("latitude");
        const auto longitude = fields.number("longitude");
        if (!latitude || !longitude || std::abs(*latitude) > 90.0 || std::abs(*longitude) > 180.0) {
            fields.complain("", "expected a latitude and a longitude in degrees");
        } else if (*latitude != 0.0 || *longitude != 0.0) {
            position = Position{*latitude, *longitude};
            position->accuracy = fields.number("horizontalAccuracy").value_or(position->accuracy);
        }
    });
    return position;
}

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

std::vector<LocationService::Asked> LocationService::friendsAskedFor(const Value::Array& handles) const {
    std::vector<Asked> asked;
    for (const Value& value : handles) {
        const std::string* handle = value.string();
        const auto person = handle == nullptr ? file_.friends.end()
                                              : std::find_if(file_.friends.begin(), file_.friends.end(),
                                                             [&](const auto& one) { return one.answersTo(*handle); });
        if (person == file_.friends.end()) {
            continue;
        }
        const auto before =
            std::find_if(asked.begin(), asked.end(), [&](const Asked& one) { return one.person == &*person; });
        if (before == asked.end()) {
            asked.push_back({*handle, &*person});
        } else if (before->handle.find('@') == std::string::npos && handle->find('@') != std::string::npos) {
            // One entry a friend; an e-mail address comes back as it was asked for, a phone number may not.
            before->handle = *handle;
        }
    }
    return asked;
}

std::optional<Dictionary> LocationService::getLocations(const Dictionary& request, const ServiceMoment& moment,
                                                        const Fault& fault, std::string& complaint) const {
    documents::Complaints complaints;
    documents::FieldReader fields(request, {}, complaints);
    if (!fields.object("clientContext", [](documents::FieldReader&) {})) {
        fields.complain("clientContext", "expected an object, found nothing");
    }
    fields.stringOrStrings("handles");
    const auto mine = readPosition(fields, "myLocation");
    const auto wanted = readPosition(fields, "requestedLocation");
    std::optional<std::string> clientId;
    fields.object("serverContext", [&](documents::FieldReader& context) { clientId = context.string("clientId"); });
    if (complaints) {
        complaint = complaints->path.text() + ": " + complaints->message;
        return std::nullopt;
    }
    const Value* handles = request.find("handles");
    const bool listed = handles != nullptr && handles->array() != nullptr;
    std::vector<Asked> asked = friendsAskedFor(listed ? *handles->array() : Value::Array());
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
        if (place && mine) {
            entry.set("distanceInMeters", metresText(distance(mine->latitude, mine->longitude, *place)));
        }
        if (place && wanted) {
            entry.set("match", distance(wanted->latitude, wanted->longitude, *place) <= kAtPlace);
        }
        locations.set(handle, entry);
        order.emplace_back(handle);
    }
    Dictionary context = serverContext(fault);
    setWhenPresent(context, "clientId", clientId);
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
    documents::Complaints complaints;
    documents::FieldReader fields(request, {}, complaints);
    std::optional<Position> position;
    const bool hasContext = fields.object(
        "clientContext", [&](documents::FieldReader& context) { position = readPosition(context, "location"); });
    if (!hasContext) {
        fields.complain("clientContext", "expected an object, found nothing");
    }
    std::optional<std::string> hide;
    fields.object("prefs", [&](documents::FieldReader& preferences) { hide = preferences.string("hideLocation"); });
    if (!complaints && hide != "Yes" && hide != "No") {
        fields.complain("prefs", R"(expected "hideLocation" to be "Yes" or "No")");
    }
    if (complaints) {
        complaint = complaints->path.text() + ": " + complaints->message;
        return std::nullopt;
    }
    if (fault.status < 300) {
        sharing_->command(hide == "Yes", position);
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
