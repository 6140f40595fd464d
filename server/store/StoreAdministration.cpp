// The part of the store that people use from a command line: every call waits for the disk.
#include "server/store/Secret.h"
#include "server/store/Store.h"

namespace ktr::server {

bool Store::addPerson(const std::string& name, const std::vector<std::string>& handles, std::int64_t now) {
    const std::int64_t person = Secret::number();
    return person != 0 && writeNow([&](Database& database) {
               database
                   .statement(
                       "INSERT INTO person (id, name, retention, looks_retention, made, identity) VALUES ($1, $2, $3, "
                       "$4, $5, {random bytes})")
                   .bind(person)
                   .bind(name)
                   .bind(Retention::kLongestFixes)
                   .bind(Retention::kLongestLooks)
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

void Store::addDeviceIn(Database& database, std::int64_t device, const NewDevice& made, std::int64_t now) {
    database
        .statement(
            "INSERT INTO device (id, person, kind, secret, key, made, shared) "
            "VALUES ($1, $2, $3, $4, $5, $6, $7)")
        .bind(device)
        .bind(made.person)
        .bind(static_cast<std::int64_t>(made.kind))
        .bindBytes(Secret::hash(made.secret))
        .bind(made.key)
        .bind(now)
        .bind(std::int64_t{made.shared})
        .run();
}

bool Store::addDevice(std::int64_t person, DeviceKind kind, std::string_view secret, std::string_view key,
                      std::int64_t now, bool shared) {
    const std::int64_t device = Secret::number();
    return device != 0 && writeNow([&](Database& database) {
               addDeviceIn(database, device, {person, kind, secret, key, shared}, now);
           });
}

std::int64_t Store::addPhoneWithLink(std::int64_t person, std::string_view secret, std::string_view link,
                                     std::int64_t now) {
    const std::int64_t device = Secret::number();
    const bool good = device != 0 && writeNow([&](Database& database) {
                          addDeviceIn(database, device, {person, DeviceKind::Phone, secret, "", false}, now);
                          addSignInIn(database, person, link, now);
                      });
    return good ? device : 0;
}

int Store::revokeDevices(std::int64_t person, std::int64_t now) {
    int ended = 0;
    const bool good = writeNow([&](Database& database) {
        database.statement("UPDATE device SET revoked = $1, asked_to_share = 0 WHERE person = $2 AND revoked IS NULL")
            .bind(now)
            .bind(person)
            .run();
        ended = database.changes();
        endBrowsersIn(database, person);
        changes(person);
    });
    return good ? ended : 0;
}

bool Store::setHidden(std::int64_t person, bool hidden, std::int64_t now) {
    return writeNow([&](Database& database) {
        if (hidden) {
            hideIn(database, person);
        } else {
            showIn(database, person, now);
        }
    });
}

bool Store::setZone(std::int64_t person, const std::string& zone) {
    return writeNow([&](Database& database) {
        database.statement("UPDATE person SET zone = $2 WHERE id = $1").bind(person).bind(zone).run();
    });
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
