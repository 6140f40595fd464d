// The part of the store that only reads: beside what is written.
#include <algorithm>
#include <iterator>

#include "platform/base/Utf8.h"
#include "server/store/Secret.h"
#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// Whether a database takes it: nobody has a name or a handle that it would not.
bool isText(std::string_view text) {
    return text.find('\0') == std::string_view::npos && platform::isValidUtf8(text);
}

}  // namespace

std::string Store::normalisedHandle(std::string_view handle) {
    std::string text;
    if (handle.find('@') != std::string_view::npos) {
        for (const char letter : handle) {
            text += letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
        }
        return text;
    }
    std::copy_if(handle.begin(), handle.end(), std::back_inserter(text),
                 [](char letter) { return letter == '+' || (letter >= '0' && letter <= '9'); });
    return text;
}

std::optional<Device> Store::deviceOf(std::string_view secret, bool& failed) {
    const Reading reading(*this);
    auto row = reading->statement(
        "SELECT device.id, kind, device.person, name, hidden, retention, key, shared, holds_events FROM device JOIN "
        "person ON "
        "person.id = device.person "
        "WHERE secret = $1 AND revoked IS NULL AND suspended = 0");
    if (!row.bindBytes(Secret::hash(secret)).next()) {
        failed = reading->failed();
        return std::nullopt;
    }
    return Device{row.integer(0),      static_cast<DeviceKind>(row.integer(1)),
                  row.integer(2),      row.text(3),
                  row.integer(4) != 0, row.integer(5),
                  row.text(6),         row.integer(7) != 0,
                  row.integer(8) != 0};
}

std::optional<std::int64_t> Store::personOf(std::string_view handle) {
    if (!isText(handle)) {
        return std::nullopt;
    }
    const Reading reading(*this);
    auto row = reading->statement("SELECT person FROM handle WHERE text = $1");
    return row.bind(std::string_view(normalisedHandle(handle))).next() ? std::optional(row.integer(0)) : std::nullopt;
}

std::vector<Person> Store::people() {
    const Reading reading(*this);
    std::vector<Person> people;
    auto row = reading->statement("SELECT id, name, hidden, zone FROM person ORDER BY name");
    while (row.next()) {
        Person person{row.integer(0), row.text(1), {}, row.integer(2) != 0, row.text(3)};
        auto handle = reading->statement("SELECT shown FROM handle WHERE person = $1 ORDER BY place");
        handle.bind(person.id);
        while (handle.next()) {
            person.handles.push_back(handle.text(0));
        }
        people.push_back(std::move(person));
    }
    return people;
}

std::optional<Person> Store::person(std::int64_t id) {
    const Reading reading(*this);
    auto row = reading->statement("SELECT id, name, hidden, zone FROM person WHERE id = $1");
    if (!row.bind(id).next()) {
        return std::nullopt;
    }
    Person person{row.integer(0), row.text(1), {}, row.integer(2) != 0, row.text(3)};
    auto handle = reading->statement("SELECT shown FROM handle WHERE person = $1 ORDER BY place");
    handle.bind(id);
    while (handle.next()) {
        person.handles.push_back(handle.text(0));
    }
    return person;
}

std::optional<Person> Store::personNamed(std::string_view name) {
    if (!isText(name)) {
        return std::nullopt;
    }
    std::int64_t id = 0;
    {
        const Reading reading(*this);
        auto row = reading->statement("SELECT id FROM person WHERE name = $1");
        if (!row.bind(name).next()) {
            return std::nullopt;
        }
        id = row.integer(0);
    }
    return person(id);
}

Sharing Store::sharingOf(Database::Run& row, int firstColumn) {
    Sharing sharing;
    sharing.hidden = row.integer(firstColumn) != 0;
    sharing.shownSince = row.integer(firstColumn + 1);
    sharing.retention = row.integer(firstColumn + 2);
    // Another process may have seen a later time.
    sharing.latest = present(row.integer(firstColumn + 3));
    if (row.maybeInteger(firstColumn + 4)) {
        sharing.grant = grantOf(row, firstColumn + 4);
    }
    return sharing;
}

void Store::readAll(Database& database, std::int64_t owner, Sharing& sharing) {
    if (!sharing.grant || sharing.hidden || sharing.latest >= sharing.grant->end()) {
        return;
    }
    if (Visibility::cellSide(sharing.grant->precision) == 0.0) {
        sharing.places = readPlaces(database, owner);
    }
    auto row = database.statement(
        "SELECT time, heard, latitude, longitude, accuracy FROM fix WHERE person = $1 AND time >= $2 ORDER BY time");
    row.bind(owner).bind(std::max(sharing.grant->from, sharing.shownSince));
    while (row.next()) {
        sharing.fixes.push_back({row.integer(0), row.integer(1), row.real(2), row.real(3), row.maybeReal(4)});
    }
}

std::optional<Sharing> Store::sharing(std::int64_t viewer, std::int64_t owner) {
    const Reading reading(*this);
    auto row = reading->statement(
        "SELECT hidden, shown_since, retention, (SELECT latest FROM clock), exactness, since, until, arrival, aloud, "
        "confirmed, fences FROM person "
        "LEFT JOIN share ON share.owner = person.id AND share.viewer = $1 WHERE person.id = $2");
    if (!row.bind(viewer).bind(owner).next()) {
        return std::nullopt;
    }
    Sharing sharing = sharingOf(row, 0);
    readAll(*reading, owner, sharing);
    return sharing;
}

std::optional<std::vector<Asked>> Store::asked(std::int64_t viewer, const std::vector<std::string>& handles,
                                               std::int64_t now) {
    const Reading reading(*this);
    std::deque<Database::Run> runs;
    for (const std::string& handle : handles) {
        // What is no text is nobody's, as this is.
        runs.emplace_back(
                "SELECT person.id, heard_late, hidden, shown_since, retention, (SELECT latest FROM clock), exactness, "
                "since, until, arrival, aloud, confirmed, fences FROM handle JOIN person ON person.id = handle.person "
                "LEFT JOIN share ON share.owner = person.id AND share.viewer = $1 WHERE handle.text = $2",
                *reading)
            .bind(viewer)
            .bind(std::string_view(isText(handle) ? normalisedHandle(handle) : "-"));
    }
    reading->fetch(runs);
    std::vector<Asked> all(handles.size());
    std::vector<Sight> sights;
    for (Asked& one : all) {
        if (Database::Run& row = runs.front(); row.next()) {
            one.person = row.integer(0);
            one.sharing = sharingOf(row, 2);
            sights.push_back({one.person, row.integer(1), &one.sharing});
        }
        runs.pop_front();
    }
    readSights(*reading, sights, now);
    return reading->failed() ? std::nullopt : std::optional(std::move(all));
}

std::vector<Friend> Store::friendsOf(std::int64_t viewer, std::int64_t now) {
    const Reading reading(*this);
    std::deque<Friend> friends;  // they stay where they are
    std::vector<Sight> sights;
    auto row = reading->statement(
        "SELECT person.id, name, heard_late, hidden, shown_since, retention, (SELECT latest FROM clock), exactness, "
        "since, until, arrival, aloud, confirmed, fences FROM share JOIN person ON person.id = share.owner WHERE "
        "share.viewer "
        "= $1 ORDER BY "
        "name");
    row.bind(viewer);
    while (row.next()) {
        friends.push_back({row.integer(0), row.text(1), sharingOf(row, 3)});
        sights.push_back({friends.back().person, row.integer(2), &friends.back().sharing});
    }
    readSights(*reading, sights, now);
    return {std::make_move_iterator(friends.begin()), std::make_move_iterator(friends.end())};
}

}  // namespace ktr::server
