#include "serve/FriendsReader.h"

#include <limits>

#include "documents/DocumentReader.h"

namespace ktr::serve {

namespace {

constexpr double kNoLimit = std::numeric_limits<double>::infinity();
constexpr double kLongestTime = 1.0e6;

double needed(documents::FieldReader& fields, const std::string& name, double most) {
    if (fields.member(name) == nullptr) {
        fields.complain(name, "expected a number, found nothing");
    }
    return fields.number(name, -most, most).value_or(0.0);
}

/// The position and the address, which a waypoint and a scenario's location name alike.
Waypoint readPlace(documents::FieldReader& fields) {
    Waypoint waypoint;
    waypoint.latitude = needed(fields, "latitude", 90.0);
    waypoint.longitude = needed(fields, "longitude", 180.0);
    waypoint.accuracy = fields.number("accuracy", 0.0, kNoLimit).value_or(waypoint.accuracy);
    waypoint.street = fields.string("street");
    waypoint.city = fields.string("city");
    waypoint.stateCode = fields.string("stateCode");
    waypoint.label = fields.string("label");
    return waypoint;
}

void readNames(documents::FieldReader& fields, ServedFriend& person) {
    person.fullName = fields.string("fullName").value_or("");
    person.firstName = fields.string("firstName").value_or("");
    person.lastName = fields.string("lastName").value_or("");
    person.identifier = fields.string("identifier").value_or("");
}

ServedFriend readPerson(documents::FieldReader& fields) {
    ServedFriend person;
    readNames(fields, person);
    person.emails = fields.stringOrStrings("emails");
    person.phones = fields.stringOrStrings("phones");
    if (person.emails.empty() && person.phones.empty()) {
        fields.complain("", "expected at least one of \"emails\" and \"phones\"");
    }
    return person;
}

ServedFriend readFriend(documents::FieldReader& fields) {
    ServedFriend person = readPerson(fields);
    person.repeats = fields.boolean("repeats").value_or(true);
    person.hidden = fields.boolean("hidden").value_or(false);
    person.locatedAfter = fields.number("locatedAfter", 0.0, kLongestTime).value_or(0.0);
    fields.objects("track", [&](documents::FieldReader& point) {
        Waypoint waypoint = readPlace(point);
        waypoint.at = point.number("at", 0.0, kLongestTime).value_or(0.0);
        waypoint.hidden = point.boolean("hidden").value_or(false);
        if (!person.track.empty() && waypoint.at <= person.track.back().at) {
            point.complain("at", "expected the waypoints in the order of their time");
        }
        person.track.push_back(std::move(waypoint));
    });
    return person;
}

/// One location of a scenario's snippet.
ServedFriend readLocation(documents::FieldReader& fields) {
    ServedFriend person;
    // A scenario tells more than a service needs; its own reader knows what is none.
    fields.leaveOthers();
    fields.object("friend", [&](documents::FieldReader& attribute) {
        attribute.leaveOthers();
        attribute.object("object", [&](documents::FieldReader& object) {
            object.leaveOthers();
            readNames(object, person);
            object.objects("emails", [&](documents::FieldReader& email) {
                email.leaveOthers();
                if (auto address = email.string("emailAddress")) {
                    person.emails.push_back(*address);
                }
            });
            object.objects("phones", [&](documents::FieldReader& phone) {
                phone.leaveOthers();
                if (auto number = phone.string("number")) {
                    person.phones.push_back(*number);
                }
            });
        });
        if (auto handle = attribute.string("data"); handle && !person.answersTo(*handle)) {
            (handle->find('@') != std::string::npos ? person.emails : person.phones).push_back(*handle);
        }
    });
    if (fields.member("latitude") != nullptr && fields.member("longitude") != nullptr) {
        person.track.push_back(readPlace(fields));
    }
    return person;
}

void readAll(documents::FieldReader& fields, FriendsFile& file) {
    file.intervalSeconds = fields.number("intervalSeconds", 0.0, kLongestTime).value_or(file.intervalSeconds);
    file.timeoutSeconds = fields.number("timeoutSeconds", 0.0, kLongestTime).value_or(file.timeoutSeconds);
    fields.object("user", [&](documents::FieldReader& user) { file.user = readPerson(user); });
    // What a scenario says of the account.
    fields.object("account", [&](documents::FieldReader& account) {
        if (const auto name = account.string("userName")) {
            file.user = ServedFriend();
            (name->find('@') != std::string::npos ? file.user.emails : file.user.phones) = {*name};
        }
    });
    const bool friends =
        fields.objects("friends", [&](documents::FieldReader& person) { file.friends.push_back(readFriend(person)); });
    const bool snippet = fields.object("snippet", [&](documents::FieldReader& object) {
        object.leaveOthers();
        if (!friends) {
            object.objects("locations",
                           [&](documents::FieldReader& place) { file.friends.push_back(readLocation(place)); });
        }
    });
    if (snippet) {
        fields.leaveOthers();
    }
    if (!friends && !snippet) {
        fields.complain("", "expected a member \"friends\", or a scenario's \"snippet\"");
    }
}

}  // namespace

std::variant<FriendsFile, documents::DocumentError> FriendsReader::readText(std::string_view text,
                                                                            const std::string& file,
                                                                            documents::DocumentWarnings* warnings) {
    FriendsFile friends;
    if (auto error = documents::DocumentReader::readText(
            text, file, [&](documents::FieldReader& fields) { readAll(fields, friends); }, warnings)) {
        return *error;
    }
    return friends;
}

std::variant<FriendsFile, documents::DocumentError> FriendsReader::readFile(const std::string& file,
                                                                            documents::DocumentWarnings* warnings) {
    const auto text = documents::DocumentReader::textOf(file, {documents::kLargestJson, {}});
    if (const auto* error = std::get_if<documents::DocumentError>(&text)) {
        return *error;
    }
    return readText(std::get<std::string>(text), file, warnings);
}

}  // namespace ktr::serve
