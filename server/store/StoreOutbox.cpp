// The part of the store that keeps what is to be told until it was: per device, in order, for a few hours.
#include <algorithm>

#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// Which of a person's devices can be told: readers, and phones whose app takes it.
constexpr const char* kCountUp =
    "UPDATE device SET events = events + 1 WHERE person = $1 AND revoked IS NULL AND suspended = 0 "
    "AND (kind <> 0 OR holds_events = 1)";

}  // namespace

void Store::tellOf(Database& database, const Fence& fence, const FenceCrossing& crossing) {
    changes(fence.watcher);
    database.statement(kCountUp).bind(fence.watcher).run();
    database
        .statement(
            "INSERT INTO outbox (device, number, watcher, subject, name, label, latitude, longitude, radius, arrives, "
            "time, made, until) SELECT id, events, $1, $2, $3, $4, $5, $6, $7, $8, $9, $10, $11 FROM device "
            "WHERE person = $1 AND revoked IS NULL AND suspended = 0 AND (kind <> 0 OR holds_events = 1)")
        .bind(fence.watcher)
        .bind(fence.subject)
        .bind(fence.name)
        .bind(fence.label)
        .bind(fence.circle.latitude)
        .bind(fence.circle.longitude)
        .bind(fence.circle.radius)
        .bind(std::int64_t{crossing.arrives})
        .bind(crossing.time)
        .bind(fence.made)
        .bind(crossing.time + FenceEvent::kLasts)
        .run();
}

std::optional<std::vector<FenceEvent>> Store::eventsFor(std::int64_t device, std::int64_t after, std::int64_t now,
                                                        int most) {
    const Reading reading(*this);
    std::vector<FenceEvent> events;
    auto row = reading->statement(
        "SELECT number, person.name, "
        "coalesce((SELECT shown FROM handle WHERE handle.person = subject ORDER BY place LIMIT 1), ''), outbox.name, "
        "label, latitude, longitude, radius, arrives, time, outbox.made, outbox.until, (SELECT latest FROM clock), "
        "exactness, since, share.until, arrival, aloud, confirmed, fences, post "
        "FROM outbox JOIN device ON device.id = outbox.device JOIN person ON person.id = subject "
        "JOIN share ON share.owner = subject AND share.viewer = watcher "
        "WHERE outbox.device = $1 AND number > $2 AND outbox.until > $3 AND hidden = 0 AND revoked IS NULL "
        "AND suspended = 0 ORDER BY number LIMIT $4");
    row.bind(device).bind(after).bind(now).bind(std::int64_t{most});
    while (row.next()) {
        // A grant may have ended by the clock alone.
        if (!grantOf(row, 13).tells(present(row.integer(12)))) {
            continue;
        }
        FenceEvent event;
        event.number = row.integer(0);
        event.name = row.text(1);
        event.handle = row.text(2);
        event.place = row.text(3);
        event.label = row.text(4);
        event.circle = {row.real(5), row.real(6), row.real(7)};
        event.arrives = row.integer(8) != 0;
        event.time = row.integer(9);
        event.made = row.integer(10);
        event.post = row.integer(20);
        events.push_back(std::move(event));
    }
    return reading->failed() ? std::nullopt : std::optional(std::move(events));
}

std::optional<bool> Store::isInUse(std::int64_t device) {
    const Reading reading(*this);
    auto row = reading->statement("SELECT id FROM device WHERE id = $1 AND revoked IS NULL AND suspended = 0");
    const bool isThere = row.bind(device).next();
    return reading->failed() ? std::nullopt : std::optional(isThere);
}

void Store::acknowledgeEvents(std::int64_t device, std::int64_t number, Done done) {
    write(
        [=](Database& database) {
            database.statement("DELETE FROM outbox WHERE device = $1 AND number <= $2").bind(device).bind(number).run();
        },
        std::move(done));
}

void Store::noteHoldsEvents(std::int64_t device, bool holds) {
    write(
        [=](Database& database) {
            database.statement("UPDATE device SET holds_events = $2 WHERE id = $1")
                .bind(device)
                .bind(std::int64_t{holds})
                .run();
        },
        nullptr);
}

void Store::noteEvents(std::int64_t device, std::int64_t number, std::int64_t post) {
    write(
        [=](Database& database) {
            // It posts something else now: it has got the answer to what it posted before.
            database.statement("DELETE FROM outbox WHERE device = $1 AND post <> 0 AND post <> $2")
                .bind(device)
                .bind(post)
                .run();
            database.statement("UPDATE outbox SET post = $3 WHERE device = $1 AND number <= $2")
                .bind(device)
                .bind(number)
                .bind(post)
                .run();
        },
        nullptr);
}

void Store::dropLateEvents(Database& database, std::int64_t now) {
    database.statement("DELETE FROM outbox WHERE until <= $1").bind(now).run();
    droppedEvents_ += static_cast<std::uint64_t>(std::max(0, database.changes()));
}

}  // namespace ktr::server
