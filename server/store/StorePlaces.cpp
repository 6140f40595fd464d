// The part of the store that knows the places which people have named.
#include <algorithm>

#include "server/store/Secret.h"
#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// Seven columns of a place, beginning with its id.
NamedPlace placeOf(Database::Run& row, int column) {
    NamedPlace place;
    place.id = row.integer(column);
    place.name = row.text(column + 1);
    place.label = row.text(column + 2);
    place.latitude = row.real(column + 3);
    place.longitude = row.real(column + 4);
    place.radius = row.real(column + 5);
    place.said = row.integer(column + 6) != 0;
    return place;
}

/// Whose grants end when the owner reaches a place.
std::vector<std::int64_t> viewersUntil(Database& database, std::int64_t owner, std::int64_t place) {
    std::vector<std::int64_t> viewers;
    auto row = database.statement("SELECT viewer FROM share WHERE owner = $1 AND arrival = $2");
    row.bind(owner).bind(place);
    while (row.next()) {
        viewers.push_back(row.integer(0));
    }
    return viewers;
}

}  // namespace

bool Store::setPlace(std::int64_t owner, const NamedPlace& place) {
    const std::int64_t id = Secret::number();
    return id != 0 && writeNow([&](Database& database) {
               changes(owner);
               database
                   .statement(
                       "INSERT INTO place (id, owner, name, label, latitude, longitude, radius, said) "
                       "VALUES ($1, $2, $3, $4, $5, $6, $7, $8) ON CONFLICT (owner, name) DO UPDATE SET "
                       "label = excluded.label, latitude = excluded.latitude, longitude = excluded.longitude, "
                       "radius = excluded.radius, said = excluded.said")
                   .bind(id)
                   .bind(owner)
                   .bind(place.name)
                   .bind(place.label)
                   .bind(place.latitude)
                   .bind(place.longitude)
                   .bind(place.radius)
                   .bind(std::int64_t{place.said})
                   .run();
           });
}

bool Store::changePlace(std::int64_t owner, const NamedPlace& place) {
    int changed = 0;
    const bool good = writeNow([&](Database& database) {
        changes(owner);
        database
            .statement(
                "UPDATE place SET name = $3, label = $4, latitude = $5, longitude = $6, radius = $7, said = $8 "
                "WHERE owner = $1 AND id = $2 AND "
                "NOT EXISTS (SELECT 1 FROM place WHERE owner = $1 AND name = $3 AND id <> $2)")
            .bind(owner)
            .bind(place.id)
            .bind(place.name)
            .bind(place.label)
            .bind(place.latitude)
            .bind(place.longitude)
            .bind(place.radius)
            .bind(std::int64_t{place.said})
            .run();
        changed = database.changes();
    });
    return good && changed > 0;
}

void Store::keepPlaces(std::int64_t owner, std::vector<NamedPlace> places, Done done) {
    write(
        [this, owner, places = std::move(places)](Database& database) {
            changes(owner);
            for (const NamedPlace& place : places) {
                database
                    .statement(
                        "INSERT INTO place (id, owner, name, label, latitude, longitude, radius, said) "
                        "SELECT $1, $2, $3, $4, $5, $6, $7, 0 FROM person WHERE id = $2 AND $1 <> 0 AND "
                        "((SELECT COUNT(*) FROM place WHERE owner = $2) < $8 OR "
                        "EXISTS (SELECT 1 FROM place WHERE owner = $2 AND name = $3)) "
                        "ON CONFLICT (owner, name) DO UPDATE SET latitude = excluded.latitude, "
                        "longitude = excluded.longitude, radius = excluded.radius")
                    .bind(Secret::number())
                    .bind(owner)
                    .bind(place.name)
                    .bind(place.label)
                    .bind(place.latitude)
                    .bind(place.longitude)
                    .bind(place.radius)
                    .bind(std::int64_t{NamedPlace::kMost})
                    .run();
            }
        },
        std::move(done));
}

bool Store::removePlace(std::int64_t owner, std::int64_t place, std::int64_t now) {
    int removed = 0;
    const bool good = writeNow([&](Database& database) {
        changes(owner);
        for (const std::int64_t viewer : viewersUntil(database, owner, place)) {
            endFencesIn(database, owner, viewer);
        }
        // Nobody arrives there any more: what was to end there would never end.
        database
            .statement(
                "UPDATE share SET until = $3, arrival = 0 WHERE owner = $1 AND arrival = $2 "
                "AND (until IS NULL OR until > $3)")
            .bind(owner)
            .bind(place)
            .bind(now)
            .run();
        database.statement("DELETE FROM place WHERE owner = $1 AND id = $2").bind(owner).bind(place).run();
        removed = database.changes();
    });
    return good && removed > 0;
}

std::optional<Fix> Store::newestFix(std::int64_t person) {
    const Reading reading(*this);
    auto row = reading->statement(
        "SELECT time, heard, latitude, longitude, accuracy FROM fix WHERE person = $1 ORDER BY time DESC LIMIT 1");
    return row.bind(person).next()
               ? std::optional(Fix{row.integer(0), row.integer(1), row.real(2), row.real(3), row.maybeReal(4)})
               : std::nullopt;
}

std::vector<NamedPlace> Store::placesOf(std::int64_t owner) {
    const Reading reading(*this);
    return readPlaces(*reading, owner);
}

void Store::askPlaces(std::deque<Database::Run>& runs, Database& database, std::int64_t owner) {
    runs.emplace_back(
            "SELECT id, name, label, latitude, longitude, radius, said FROM place WHERE owner = $1 ORDER BY name",
            database)
        .bind(owner);
}

std::vector<NamedPlace> Store::placesIn(Database::Run& row) {
    std::vector<NamedPlace> places;
    while (row.next()) {
        places.push_back(placeOf(row, 0));
    }
    return places;
}

std::vector<NamedPlace> Store::readPlaces(Database& database, std::int64_t owner) {
    std::deque<Database::Run> runs;
    askPlaces(runs, database, owner);
    return placesIn(runs.front());
}

void Store::endOnArrival(Database& database, std::int64_t owner, const std::vector<Fix>& fixes, std::int64_t now) {
    std::vector<std::int64_t> ended;
    {
        auto row = database.statement(
            "SELECT place.id, place.name, label, latitude, longitude, radius, said, viewer, since, shown_since "
            "FROM share JOIN place ON place.id = share.arrival JOIN person ON person.id = share.owner "
            "WHERE share.owner = $1 AND arrival <> 0 AND hidden = 0 AND (until IS NULL OR until > $2)");
        row.bind(owner).bind(now);
        while (row.next()) {
            const NamedPlace place = placeOf(row, 0);
            const std::int64_t first = std::max(row.integer(8), row.integer(9));
            if (std::any_of(fixes.begin(), fixes.end(), [&](const Fix& fix) {
                    return std::min(fix.time, fix.heard) >= first && place.holds(fix);
                })) {
                ended.push_back(row.integer(7));
            }
        }
    }
    for (const std::int64_t viewer : ended) {
        changes(owner);
        changes(viewer);
        database.statement("UPDATE share SET until = $3 WHERE owner = $1 AND viewer = $2")
            .bind(owner)
            .bind(viewer)
            .bind(now)
            .run();
        endFencesIn(database, owner, viewer);
    }
}

}  // namespace ktr::server
