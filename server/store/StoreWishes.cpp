// The part of the store that keeps who wants to see a newer fix of whom, until a phone was told or nobody waits any
// more.
#include <algorithm>

#include "platform/base/Utf8.h"
#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// Whether somebody's wish may be told to the phone of whom it is about: whoever sees exactly, since before the wish.
/// Below that what is seen follows a grid of time, which no phone can be asked to hurry.
bool mayBeTold(const Grant& grant, std::int64_t since, std::int64_t latest) {
    return grant.precision == Precision::Exact && grant.from <= since && latest < grant.end();
}

}  // namespace

void Store::wishForFix(std::int64_t viewer, const std::vector<std::string>& handles, std::int64_t now, WishDone done) {
    const auto since = std::make_shared<std::vector<std::int64_t>>();
    write(
        [=](Database& database) {
            since->clear();
            std::int64_t standing = 0;
            {
                auto row = database.statement("SELECT count(*) FROM fix_wish WHERE viewer = $1 AND since > $2");
                standing = row.bind(viewer).bind(now - kWishLasts).next() ? row.integer(0) : 0;
            }
            for (const std::string& handle : handles) {
                // The same is written for a handle that nobody has: it takes as long.
                const std::string text = platform::isValidUtf8(handle) && handle.find('\0') == std::string::npos
                                             ? normalisedHandle(handle)
                                             : "";
                if (standing < kMostWishes) {
                    database
                        .statement(
                            "INSERT INTO fix_wish (handle, viewer, since) VALUES ($1, $2, $3) "
                            "ON CONFLICT (handle, viewer) DO UPDATE SET since = excluded.since "
                            "WHERE fix_wish.since <= $4 OR fix_wish.since > excluded.since")
                        .bind(std::string_view(text))
                        .bind(viewer)
                        .bind(now)
                        .bind(now - kWishLasts)
                        .run();
                    standing += std::max(0, database.changes());
                }
                auto row =
                    database.statement("SELECT since FROM fix_wish WHERE handle = $1 AND viewer = $2 AND since > $3");
                const bool stands = row.bind(std::string_view(text)).bind(viewer).bind(now - kWishLasts).next();
                since->push_back(stands ? row.integer(0) : 0);
            }
        },
        [since, done = std::move(done)](bool good) { done(good ? std::optional(*since) : std::nullopt); });
}

void Store::takeWishes(std::int64_t person, std::int64_t newest, std::int64_t now, std::function<void(bool)> done) {
    const auto isAsked = std::make_shared<bool>(false);
    write(
        [=, this](Database& database) {
            *isAsked = false;
            struct Wish {
                std::int64_t viewer;
                std::int64_t since;
                std::int64_t told;
                Grant grant;
            };
            std::vector<Wish> wishes;
            std::int64_t shown = 0;
            std::int64_t seen = newest;
            std::int64_t latest = now;
            {
                auto row = database.statement(
                    "SELECT fix_wish.viewer, fix_wish.since, told, shown_since, "
                    "coalesce((SELECT max(time) FROM fix WHERE fix.person = $1), 0), (SELECT latest FROM clock), "
                    "exactness, share.since, until, arrival, aloud, confirmed, fences "
                    "FROM handle JOIN fix_wish ON fix_wish.handle = handle.text "
                    "JOIN person ON person.id = handle.person "
                    "JOIN share ON share.owner = handle.person AND share.viewer = fix_wish.viewer "
                    "WHERE handle.person = $1 AND hidden = 0 AND fix_wish.since > $2");
                row.bind(person).bind(now - kWishLasts);
                while (row.next()) {
                    wishes.push_back({row.integer(0), row.integer(1), row.integer(2), grantOf(row, 6)});
                    shown = row.integer(3);
                    seen = std::max(seen, row.integer(4));
                    latest = present(std::max(now, row.integer(5)));
                }
            }
            for (const Wish& wish : wishes) {
                // Somebody has several handles: whoever asks by each of them asks once.
                const bool wasTold = std::any_of(wishes.begin(), wishes.end(), [&](const Wish& other) {
                    return other.viewer == wish.viewer && other.told > now - kWishLasts && other.told <= now;
                });
                const bool isOpen = wish.told < wish.since && wish.since >= shown && seen < wish.since;
                if (wasTold || !isOpen || !mayBeTold(wish.grant, wish.since, latest)) {
                    continue;
                }
                // Of two phones at once one is told.
                database
                    .statement(
                        "UPDATE fix_wish SET told = $3 WHERE viewer = $2 AND told < since AND "
                        "handle IN (SELECT text FROM handle WHERE person = $1)")
                    .bind(person)
                    .bind(wish.viewer)
                    .bind(now)
                    .run();
                *isAsked = *isAsked || database.changes() > 0;
            }
        },
        [isAsked, done = std::move(done)](bool good) { done(good && *isAsked); });
}

void Store::dropOldWishes(Database& database, std::int64_t now) {
    // Twice as long as they last: who was told within that time is not told again.
    database.statement("DELETE FROM fix_wish WHERE since <= $1").bind(now - 2 * kWishLasts).run();
}

}  // namespace ktr::server
