#include "serve/MadeUpPeople.h"

#include <algorithm>

#include "platform/base/Json.h"
#include "server/http/BasicCredentials.h"
#include "server/store/Secret.h"

namespace ktr::serve {

using server::DeviceKind;
using server::NamedPlace;
using server::Store;

namespace {

/// Of one person's track.
constexpr std::size_t kMostNamed = 20;

/// A name that nobody in a friends file needs: several may be called alike, or not at all.
std::string nameOf(std::size_t number) {
    return "friend-" + std::to_string(number);
}

}  // namespace

MadeUpPeople::MadeUpPeople(const FriendsFile& file, const std::string& personId, const std::string& token,
                           std::int64_t now)
    : store_(Store::open(server::StoreAddress::inMemory(), true, complaint_)) {
    if (store_ && !make(file, personId, token, now)) {
        complaint_ = "the people cannot be made";
    }
}

bool MadeUpPeople::make(const FriendsFile& file, const std::string& personId, const std::string& token,
                        std::int64_t now) {
    for (const ServedFriend& person : file.friends) {
        const std::string name = nameOf(secrets_.size());
        const auto secret = server::Secret::make();
        if (!secret || !add(name, person, now)) {
            return false;
        }
        friends_.push_back(store_->personNamed(name)->id);
        secrets_.push_back(*secret);
        if (!store_->addDevice(friends_.back(), DeviceKind::Phone, *secret, "", now) ||
            !namePlaces(friends_.back(), person)) {
            return false;
        }
    }
    if (!add(personId, file.user, now)) {
        return false;
    }
    owner_ = store_->personNamed(personId)->id;
    bool failed = !store_->addDevice(owner_, DeviceKind::Reader, token, "", now);
    const auto reader = store_->deviceOf(token, failed);
    reader_ = reader ? reader->id : 0;
    return reader && std::all_of(friends_.begin(), friends_.end(), [&](std::int64_t person) {
               server::Grant grant{server::Precision::Exact, now, std::nullopt};
               grant.fences = true;
               return store_->grant(person, owner_, grant);
           });
}

bool MadeUpPeople::namePlaces(std::int64_t person, const ServedFriend& of) {
    std::vector<std::string> named;
    for (const Waypoint& waypoint : of.track) {
        const std::string name = waypoint.label.value_or("");
        if (!NamedPlace::isName(name) || named.size() == kMostNamed ||
            std::find(named.begin(), named.end(), name) != named.end()) {
            continue;
        }
        named.push_back(name);
        // "Home" is the sort of place that everybody has.
        std::string sort = name;
        std::transform(sort.begin(), sort.end(), sort.begin(), [](char letter) {
            return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter + 'a' - 'A') : letter;
        });
        NamedPlace place;
        place.name = name;
        place.label = NamedPlace::isLabel(sort) ? sort : "other";
        place.latitude = waypoint.latitude;
        place.longitude = waypoint.longitude;
        place.radius = NamedPlace::kLeastRadius;
        place.said = true;
        if (!store_->setPlace(person, place)) {
            return false;
        }
    }
    return true;
}

bool MadeUpPeople::add(const std::string& name, const ServedFriend& person, std::int64_t now) {
    std::vector<std::string> handles;
    std::vector<std::string> taken;
    for (const auto* list : {&person.emails, &person.phones}) {
        for (const std::string& handle : *list) {
            const std::string plain = Store::normalisedHandle(handle);
            const bool isNew = std::find(taken.begin(), taken.end(), plain) == taken.end();
            if (!plain.empty() && isNew && !store_->personOf(handle)) {
                handles.push_back(handle);
                taken.push_back(plain);
            }
        }
    }
    return store_->addPerson(name, handles, now);
}

void MadeUpPeople::setHidden(std::size_t number, bool hidden, std::int64_t now) const {
    const std::int64_t id = friends_.at(number);
    if (const auto person = store_->person(id); person && person->hidden != hidden) {
        store_->setHidden(id, hidden, now);
    }
}

server::HttpRequest MadeUpPeople::post(std::size_t number, const Waypoint& place, std::int64_t now) const {
    server::HttpRequest request;
    request.method = "POST";
    request.path = "/pub";
    request.headers = {{"Authorization", server::BasicCredentials{nameOf(number), secrets_.at(number)}.header()},
                       {"Content-Type", "application/json; charset=utf-8"}};
    request.body = platform::writeJson(platform::Dictionary{{"_type", "location"},
                                                            {"tid", "me"},
                                                            {"t", "u"},
                                                            {"lat", place.latitude},
                                                            {"lon", place.longitude},
                                                            {"acc", place.accuracy},
                                                            {"tst", now}});
    return request;
}

}  // namespace ktr::serve
