// The part of the store that people use from a command line: every call waits for the disk.
#include "server/ingest/FixRules.h"
#include "server/store/Secret.h"
#include "server/store/Store.h"

namespace ktr::server {

bool Store::addPerson(const std::string& name, const std::vector<std::string>& handles, std::int64_t now) {
    const std::int64_t person = Secret::number();
    return person != 0 && writeNow([&](Database& database) {
               database.statement("INSERT INTO person (id, name, retention, made) VALUES ($1, $2, $3, $4)")
                   .bind(person)
                   .bind(name)
                   .bind(FixRules::kRetention)
                   .bind(now)
                   .run();
               std::int64_t place = 0;
               for (const std::string& handle : handles) {
                   database.statement("INSERT INTO handle (text, shown, place, person) VALUES ($1, $2, $3, $4)")
                       .bind(normalisedHandle(handle))
                       .bind(handle)
                       .bind(++place)
                       .bind(person)
                       .run();
               }
           });
}

bool Store::addDevice(std::int64_t person, DeviceKind kind, std::string_view secret, std::string_view key,
                      std::int64_t now) {
    const std::int64_t device = Secret::number();
    return device != 0 && writeNow([&](Database& database) {
               database
                   .statement(
                       "INSERT INTO device (id, person, kind, secret, key, made) VALUES ($1, $2, $3, $4, $5, $6)")
                   .bind(device)
                   .bind(person)
                   .bind(static_cast<std::int64_t>(kind))
                   .bindBytes(Secret::hash(secret))
                   .bind(key)
                   .bind(now)
                   .run();
           });
}

bool Store::grant(std::int64_t owner, std::int64_t viewer, const Grant& grant) {
    return writeNow([&](Database& database) {
        database
            .statement(
                "INSERT INTO share (viewer, owner, exactness, since, until) VALUES ($1, $2, $3, $4, $5) "
                "ON CONFLICT (viewer, owner) DO UPDATE SET exactness = excluded.exactness, since = excluded.since, "
                "until = excluded.until")
            .bind(viewer)
            .bind(owner)
            .bind(static_cast<std::int64_t>(grant.precision))
            .bind(grant.from)
            .bind(grant.until)
            .run();
    });
}

bool Store::revokeGrant(std::int64_t owner, std::int64_t viewer) {
    int ended = 0;
    const bool good = writeNow([&](Database& database) {
        database.statement("DELETE FROM share WHERE viewer = $1 AND owner = $2").bind(viewer).bind(owner).run();
        ended = database.changes();
    });
    return good && ended > 0;
}

int Store::revokeDevices(std::int64_t person, std::int64_t now) {
    int ended = 0;
    const bool good = writeNow([&](Database& database) {
        database.statement("UPDATE device SET revoked = $1 WHERE person = $2 AND revoked IS NULL")
            .bind(now)
            .bind(person)
            .run();
        ended = database.changes();
        endBrowsersIn(database, person);
    });
    return good ? ended : 0;
}

bool Store::setHidden(std::int64_t person, bool hidden, std::int64_t now) {
    return writeNow([&](Database& database) {
        // Showing twice changes nothing: what was seen in between stays.
        database
            .statement(
                "UPDATE person SET shown_since = CASE WHEN hidden = 1 AND $2 = 0 THEN $3 ELSE shown_since END, "
                "hidden = $2 WHERE id = $1")
            .bind(person)
            .bind(std::int64_t{hidden})
            .bind(now)
            .run();
    });
}

std::vector<std::pair<std::string, Grant>> Store::grantsOf(std::int64_t owner) {
    const Reading reading(*this);
    std::vector<std::pair<std::string, Grant>> grants;
    auto row = reading->statement(
        "SELECT name, exactness, since, until FROM share JOIN person ON person.id = viewer WHERE owner = $1 ORDER BY "
        "name");
    row.bind(owner);
    while (row.next()) {
        grants.emplace_back(row.text(0),
                            Grant{static_cast<Precision>(row.integer(1)), row.integer(2), row.maybeInteger(3)});
    }
    return grants;
}

std::optional<std::int64_t> Store::lastHeard(std::int64_t person) {
    const Reading reading(*this);
    auto row = reading->statement("SELECT max(heard) FROM device WHERE person = $1");
    return row.bind(person).next() ? row.maybeInteger(0) : std::nullopt;
}

std::string Store::check() {
    const Reading reading(*this);
    return reading->check();
}

}  // namespace ktr::server
