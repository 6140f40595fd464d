#include "serve/LocationService.h"

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <array>
#include <cmath>

#include "server/answers/CommandRequest.h"

namespace ktr::serve {

using platform::Dictionary;
using platform::Value;

namespace {

constexpr int kPartial = 416;
constexpr int kNotReported = 411;

/// How near to a street's waypoint an address has that street, and to a town's that town, metres.
constexpr double kInStreet = 75.0;
constexpr double kInTown = 10000.0;

/// The members that say what a place is called.
constexpr std::array kNames = {"streetAddress", "address", "labels"};

void setWhenPresent(Dictionary& dictionary, const char* name, const std::optional<std::string>& text) {
    if (text) {
        dictionary.set(name, *text);
    }
}

/// What the place is called, where the friends file says anything of that; else it is what the service calls it.
void addWords(Dictionary& location, const Waypoint& place) {
    if (!place.street && !place.city && !place.stateCode && !place.label) {
        return;
    }
    for (const char* name : kNames) {
        location.remove(name);
    }
    Dictionary address;
    setWhenPresent(address, "locality", place.city);
    setWhenPresent(address, "stateCode", place.stateCode);
    setWhenPresent(location, "streetAddress", place.street);
    location.set("address", address.empty() ? Value() : Value(address));
    location.set("labels", place.label ? Value(Value::Array{Dictionary{{"label", *place.label}}}) : Value());
}

Dictionary memberOf(const Dictionary& dictionary, const char* name) {
    const Value* value = dictionary.find(name);
    return value == nullptr || value->dictionary() == nullptr ? Dictionary() : *value->dictionary();
}

}  // namespace

std::int64_t ServiceMoment::wholeSeconds() const {
    return static_cast<std::int64_t>(std::floor(millisecondsSince1970 / 1000.0));
}

LocationService::LocationService(FriendsFile file, const std::string& personId, const std::string& token,
                                 std::int64_t now)
    : file_(std::move(file)),
      people_(file_, personId, token, now),
      sharing_(std::make_unique<SharingState>(people_.store(), people_.owner(), people_.reader())) {}

double LocationService::distance(double latitude, double longitude, const Waypoint& place) {
    double metres = 0.0;
    GeographicLib::Geodesic::WGS84().Inverse(latitude, longitude, place.latitude, place.longitude, metres);
    return metres;
}

const ServedFriend* LocationService::friendWith(const std::string& handle) const {
    const auto person = std::find_if(file_.friends.begin(), file_.friends.end(),
                                     [&](const ServedFriend& one) { return one.answersTo(handle); });
    return person == file_.friends.end() ? nullptr : &*person;
}

std::vector<server::HttpRequest> LocationService::posts(const std::vector<std::string>& handles,
                                                        const ServiceMoment& moment) const {
    std::vector<std::size_t> asked;
    for (const std::string& handle : handles) {
        if (const ServedFriend* person = friendWith(handle)) {
            asked.push_back(static_cast<std::size_t>(person - file_.friends.data()));
        }
    }
    return postsOf(std::move(asked), moment);
}

std::vector<server::HttpRequest> LocationService::watchedPosts(const ServiceMoment& moment) const {
    std::vector<std::size_t> watched;
    for (const auto& [fence, name, handle] :
         people_.store()->fencesBy(people_.owner()).value_or(std::vector<server::FenceFacts>())) {
        for (std::size_t number = 0; number < file_.friends.size(); ++number) {
            if (people_.friendAt(number) == fence.subject) {
                watched.push_back(number);
            }
        }
    }
    return postsOf(std::move(watched), moment);
}

std::vector<server::HttpRequest> LocationService::postsOf(std::vector<std::size_t> friends,
                                                          const ServiceMoment& moment) const {
    std::sort(friends.begin(), friends.end());
    friends.erase(std::unique(friends.begin(), friends.end()), friends.end());
    std::vector<server::HttpRequest> posts;
    for (const std::size_t number : friends) {
        const ServedFriend& person = file_.friends[number];
        people_.setHidden(number, person.hidesAt(moment.seconds), moment.wholeSeconds());
        if (const auto place = person.placeAt(moment.seconds)) {
            posts.push_back(people_.post(number, *place, moment.wholeSeconds()));
        }
    }
    return posts;
}

std::optional<Dictionary> LocationService::entryOf(const std::string& handle, const Value* given,
                                                   const ServiceMoment& moment, const Fault& fault) const {
    const ServedFriend* person = friendWith(handle);
    if (person == nullptr) {
        return std::nullopt;
    }
    const bool faulty = fault.entryStatus && (fault.entry.empty() || person->answersTo(fault.entry));
    if (given == nullptr && !faulty && !person->hidden) {
        return std::nullopt;
    }
    Dictionary entry =
        given != nullptr ? *given->dictionary() : Dictionary{{"status", kNotReported}, {"location", Value()}};
    if (faulty) {
        entry.set("status", *fault.entryStatus);
    }
    if (const auto place = person->placeAt(moment.seconds); place && given != nullptr) {
        Dictionary location = memberOf(entry, "location");
        addWords(location, *place);
        entry.set("location", location);
    }
    return entry;
}

void LocationService::completeLocations(Dictionary& answer, const ServiceMoment& moment, const Fault& fault) const {
    const Dictionary given = memberOf(answer, "locations");
    const Value* listed = answer.find("emails");
    Value::Array handles = listed == nullptr || listed->array() == nullptr ? Value::Array() : *listed->array();
    if (fault.statusCode == kPartial) {
        handles.resize((handles.size() + 1) / 2);
    }
    Dictionary locations;
    for (const Value& handle : handles) {
        if (const auto entry = entryOf(*handle.string(), given.find(*handle.string()), moment, fault)) {
            locations.set(*handle.string(), *entry);
        }
    }
    answer.set("locations", locations);
    answer.set("emails", handles);
    completeContext(answer, fault);
}

void LocationService::completeContext(Dictionary& answer, const Fault& fault) const {
    if (fault.statusCode) {
        answer.set("statusCode", *fault.statusCode);
    }
    Dictionary context = memberOf(answer, "serverContext");
    context.set("minCallbackIntervalInMS", std::round(fault.intervalSeconds.value_or(file_.intervalSeconds) * 1000.0));
    context.set("callbackTimeoutIntervalInMS", std::round(file_.timeoutSeconds * 1000.0));
    answer.set("serverContext", context);
}

void LocationService::completeSharing(Dictionary& answer, const Dictionary& request, const ServiceMoment& moment,
                                      const Fault& fault) const {
    std::string complaint;
    if (const auto asks = server::SharingRequest::read(request, complaint)) {
        std::optional<SharingState::Position> position;
        if (asks->place) {
            position = SharingState::Position{asks->place->latitude, asks->place->longitude};
            position->accuracy = asks->place->accuracy.value_or(position->accuracy);
        }
        sharing_->commanded(asks->hides, position);
    }
    Dictionary myInfo = memberOf(answer, "myInfo");
    const Value* hidden = myInfo.find("hidden");
    const auto position = sharing_->now().position;
    if (hidden != nullptr && hidden->boolean() == false && position) {
        Dictionary location{{"latitude", position->latitude},
                            {"longitude", position->longitude},
                            {"horizontalAccuracy", position->accuracy},
                            {"timestamp", std::floor(moment.millisecondsSince1970)}};
        const Dictionary named = memberOf(myInfo, "location");
        for (const char* name : kNames) {
            if (const Value* value = named.find(name)) {
                location.set(name, *value);
            }
        }
        addWords(location, placeAt(position->latitude, position->longitude));
        myInfo.set("location", location);
    }
    answer.set("myInfo", myInfo);
    completeContext(answer, fault);
}

void LocationService::completeWish(Dictionary& answer, const Dictionary& request) const {
    const Value* wish = request.find("wish");
    const bool hides = wish != nullptr && *wish == Value("hide");
    const bool shows = wish != nullptr && *wish == Value("share");
    if ((hides || shows) && request.find("with") == nullptr) {
        sharing_->wished(hides);
    }
    completeContext(answer, {});
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

}  // namespace ktr::serve
