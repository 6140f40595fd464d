// The part of the store that the service writes while it runs: nobody waits for it.
#include <algorithm>
#include <utility>

#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// More than this at a step makes those who post wait.
constexpr std::int64_t kPeopleAStep = 10;

/// Whether there are fences around a person, and grants that end where they arrive: one way to the database for the
/// many of whom there is neither.
std::pair<bool, bool> whatWaitsFor(Database& database, std::int64_t person) {
    auto row = database.statement(
        "SELECT (SELECT count(*) FROM fence WHERE subject = $1), "
        "(SELECT count(*) FROM share WHERE owner = $1 AND arrival <> 0)");
    row.bind(person);
    return row.next() ? std::pair(row.integer(0) != 0, row.integer(1) != 0) : std::pair(false, false);
}

}  // namespace

void Store::keep(std::int64_t device, std::int64_t person, std::vector<Fix> fixes, std::int64_t now, Done done) {
    write(
        [=, this, all = std::move(fixes)](Database& database) {
            if (std::any_of(all.begin(), all.end(), [now](const Fix& fix) { return FixWalk::isLate(fix, now); })) {
                database.statement("UPDATE person SET heard_late = $2 WHERE id = $1 AND heard_late < $2 AND hidden = 0")
                    .bind(person)
                    .bind(now)
                    .run();
            }
            // In the same commit as the question whether the person hides: nothing of that time comes in, then or
            // later.
            for (const Fix& fix : all) {
                database
                    .statement(
                        "INSERT INTO fix (person, time, heard, latitude, longitude, accuracy) "
                        "SELECT $1, $2, $3, $4, $5, $6 FROM person WHERE id = $1 AND hidden = 0 "
                        "AND shown_since <= $2 AND NOT EXISTS (SELECT 1 FROM device WHERE device.id = $7 AND "
                        "revoked IS NOT NULL) {shared lock} ON CONFLICT DO NOTHING")
                    .bind(person)
                    .bind(fix.time)
                    .bind(fix.heard)
                    .bind(fix.latitude)
                    .bind(fix.longitude)
                    .bind(fix.accuracy)
                    .bind(device)
                    .run();
            }
            if (!all.empty()) {
                moves(person);
                const auto [fences, arrivals] = whatWaitsFor(database, person);
                if (fences) {
                    watchFences(database, person, all, now);
                }
                if (arrivals) {
                    endOnArrival(database, person, all, now);
                }
            }
            database
                .statement(
                    "UPDATE device SET heard = $2 WHERE id = $1 AND revoked IS NULL AND "
                    "(SELECT hidden FROM person WHERE person.id = device.person) = 0")
                .bind(device)
                .bind(now)
                .run();
        },
        std::move(done));
}

void Store::hide(std::int64_t person, std::int64_t, Done done) {
    write([=, this](Database& database) { hideIn(database, person); }, std::move(done));
}

void Store::noteLooks(std::int64_t viewer, std::vector<std::int64_t> owners, bool asked, std::int64_t now, Done done) {
    write(
        [=, all = std::move(owners)](Database& database) {
            for (const std::int64_t owner : all) {
                database
                    .statement(
                        "INSERT INTO viewed (owner, hour, viewer, asked) VALUES ($1, $2, $3, $4) "
                        "ON CONFLICT (owner, hour, viewer) DO UPDATE SET asked = 1 WHERE excluded.asked = 1")
                    .bind(owner)
                    .bind(now / 3600)
                    .bind(viewer)
                    .bind(std::int64_t{asked})
                    .run();
            }
        },
        std::move(done));
}

void Store::deleteOldOf(Database& database, std::int64_t person, const Retention& retention, std::int64_t now) {
    database.statement("DELETE FROM fix WHERE person = $1 AND time < $2")
        .bind(person)
        .bind(now - retention.fixes)
        .run();
    database.statement("DELETE FROM viewed WHERE owner = $1 AND hour < $2")
        .bind(person)
        .bind((now - retention.looks) / 3600)
        .run();
    database.statement("DELETE FROM ask WHERE asker = $1 AND time < $2").bind(person).bind(now - kAsksKept).run();
}

void Store::deleteOld(std::int64_t now, Done done) {
    write(
        [this, now](Database& database) {
            std::vector<std::pair<std::int64_t, Retention>> people;
            {
                auto row = database.statement(
                    "SELECT id, retention, looks_retention FROM person WHERE id > $1 ORDER BY id LIMIT $2");
                row.bind(lastSwept_).bind(kPeopleAStep);
                while (row.next()) {
                    people.emplace_back(row.integer(0), Retention{row.integer(1), row.integer(2)});
                }
            }
            for (const auto& [person, retention] : people) {
                deleteOldOf(database, person, retention, now);
            }
            dropLateEvents(database, now);
            dropOldWishes(database, now);
            lastSwept_ = people.size() < static_cast<std::size_t>(kPeopleAStep) ? 0 : people.back().first;
        },
        std::move(done));
}

}  // namespace ktr::server
