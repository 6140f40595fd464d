// The part of the store that knows phones and readers one by one.
#include <algorithm>

#include "server/store/Store.h"

namespace ktr::server {

std::vector<DeviceFacts> Store::devicesOf(std::int64_t person) {
    const Reading reading(*this);
    std::vector<DeviceFacts> devices;
    auto row = reading->statement(
        "SELECT id, kind, shared, made, heard, revoked FROM device WHERE person = $1 ORDER BY made, id");
    row.bind(person);
    while (row.next()) {
        devices.push_back({row.integer(0), static_cast<DeviceKind>(row.integer(1)), row.integer(2) != 0, row.integer(3),
                           row.maybeInteger(4), row.maybeInteger(5)});
    }
    return devices;
}

bool Store::revokeDevice(std::int64_t person, std::int64_t device, std::int64_t now) {
    int ended = 0;
    const bool good = writeNow([&](Database& database) {
        database
            .statement(
                "UPDATE device SET revoked = $3, asked_to_share = 0 WHERE person = $1 AND id = $2 AND revoked IS NULL")
            .bind(person)
            .bind(device)
            .bind(now)
            .run();
        ended = database.changes();
        changes(person);
    });
    return good && ended > 0;
}

void Store::askToShare(std::int64_t device, Done done) {
    write(
        [=](Database& database) {
            database.statement("UPDATE device SET asked_to_share = 1 WHERE id = $1 AND revoked IS NULL")
                .bind(device)
                .run();
        },
        std::move(done));
}

void Store::shareAsAsked(std::int64_t device, std::int64_t now, Done done) {
    write(
        [=, this](Database& database) {
            // No hiding comes in between: it writes the person first.
            database
                .statement(
                    "UPDATE person SET hidden = hidden WHERE id = (SELECT person FROM device WHERE device.id = $1)")
                .bind(device)
                .run();
            std::int64_t person = 0;
            {
                // Every hiding, wherever it came from, has taken the wishes of all devices back.
                auto row = database.statement(
                    "SELECT person FROM device WHERE id = $1 AND asked_to_share = 1 AND revoked IS NULL");
                person = row.bind(device).next() ? row.integer(0) : 0;
            }
            if (person != 0) {
                showIn(database, person, now);
            }
        },
        std::move(done));
}

void Store::hideIn(Database& database, std::int64_t person) {
    changes(person);
    database.statement("UPDATE person SET hidden = 1 WHERE id = $1").bind(person).run();
    database.statement("UPDATE device SET asked_to_share = 0 WHERE person = $1").bind(person).run();
    endFencesIn(database, person, std::nullopt);
}

void Store::showIn(Database& database, std::int64_t person, std::int64_t now) {
    changes(person);
    // Showing twice changes nothing: what was seen in between stays.
    database.statement("UPDATE person SET shown_since = $2, hidden = 0 WHERE id = $1 AND hidden = 1")
        .bind(person)
        .bind(afterAllHeard(database, person, now))
        .run();
}

std::int64_t Store::afterAllHeard(Database& database, std::int64_t person, std::int64_t now) {
    // Times are whole seconds: what came earlier in this one is from before.
    auto row = database.statement("SELECT max(heard) FROM fix WHERE person = $1");
    const auto heard = row.bind(person).next() ? row.maybeInteger(0) : std::nullopt;
    return std::max(present(now), heard ? *heard + 1 : 0);
}

}  // namespace ktr::server
