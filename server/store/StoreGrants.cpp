// The part of the store that knows who lets whom see what, and who did look.
#include <algorithm>

#include "server/store/Store.h"

namespace ktr::server {

namespace {

/// Whether who saw at one precision saw all that is seen at another.
bool covers(Precision one, Precision other) {
    return one == other || one == Precision::Exact || (other != Precision::Places && one < other);
}

/// Who has a handle in the form that is kept; 0: nobody.
std::int64_t personIn(Database& database, const std::string& handle) {
    auto row = database.statement("SELECT person FROM handle WHERE text = $1");
    return row.bind(std::string_view(handle)).next() ? row.integer(0) : 0;
}

}  // namespace

Grant Store::grantOf(const Database::Run& row, int column) {
    Grant grant;
    grant.precision = static_cast<Precision>(row.integer(column));
    grant.from = row.integer(column + 1);
    grant.until = row.maybeInteger(column + 2);
    grant.arrival = row.integer(column + 3);
    grant.aloud = row.integer(column + 4) != 0;
    grant.confirmed = row.maybeInteger(column + 5);
    grant.fences = row.integer(column + 6) != 0;
    return grant;
}

std::optional<Grant> Store::readGrant(Database& database, std::int64_t owner, std::int64_t viewer) {
    auto row = database.statement(
        "SELECT exactness, since, until, arrival, aloud, confirmed, fences FROM share WHERE owner = $1 AND viewer = "
        "$2");
    return row.bind(owner).bind(viewer).next() ? std::optional(grantOf(row, 0)) : std::nullopt;
}

void Store::grantIn(Database& database, std::int64_t owner, std::int64_t viewer, const Grant& grant) {
    changes(owner);
    changes(viewer);
    const std::int64_t latest = present(0);
    const auto before = readGrant(database, owner, viewer);
    // Whoever saw as exactly until now goes on seeing; else nothing from before is seen.
    const bool goesOn = before && latest < before->end() && covers(before->precision, grant.precision);
    const std::int64_t since = goesOn ? std::min(before->from, grant.from) : afterAllHeard(database, owner, grant.from);
    // The question comes 90 days after somebody said so, not after what is seen begins.
    const auto confirmed = grant.confirmed || grant.until || latest <= since ? grant.confirmed : latest;
    database
        .statement(
            "INSERT INTO share (viewer, owner, exactness, since, until, arrival, aloud, confirmed, fences) "
            "VALUES ($1, $2, $3, $4, $5, $6, $7, $8, $9) ON CONFLICT (viewer, owner) DO UPDATE SET "
            "exactness = excluded.exactness, since = excluded.since, until = excluded.until, "
            "arrival = excluded.arrival, aloud = excluded.aloud, confirmed = excluded.confirmed, "
            "fences = excluded.fences")
        .bind(viewer)
        .bind(owner)
        .bind(static_cast<std::int64_t>(grant.precision))
        .bind(since)
        .bind(grant.until)
        .bind(grant.arrival)
        .bind(std::int64_t{grant.aloud})
        .bind(confirmed)
        .bind(std::int64_t{grant.fences})
        .run();
    Grant kept = grant;
    kept.from = since;
    if (!goesOn || !kept.tells(latest)) {
        endFencesIn(database, owner, viewer);
    }
}

bool Store::grant(std::int64_t owner, std::int64_t viewer, const Grant& grant) {
    return writeNow([&](Database& database) { grantIn(database, owner, viewer, grant); });
}

bool Store::revokeGrant(std::int64_t owner, std::int64_t viewer) {
    int ended = 0;
    const bool good = writeNow([&](Database& database) {
        changes(owner);
        changes(viewer);
        database.statement("DELETE FROM share WHERE viewer = $1 AND owner = $2").bind(viewer).bind(owner).run();
        ended = database.changes();
        endFencesIn(database, owner, viewer);
    });
    return good && ended > 0;
}

void Store::revokeByHandleIn(Database& database, std::int64_t owner, const std::string& handle) {
    std::int64_t viewer = 0;
    {
        // One question whoever has the handle: it takes as long for nobody.
        auto row = database.statement(
            "DELETE FROM share WHERE owner = $1 AND viewer = (SELECT person FROM handle WHERE text = $2) "
            "RETURNING viewer");
        if (!row.bind(owner).bind(std::string_view(handle)).next()) {
            return;
        }
        viewer = row.integer(0);
    }
    changes(owner);
    changes(viewer);
    endFencesIn(database, owner, viewer);
}

bool Store::changeRules(std::int64_t owner, const std::vector<std::string>& handles, const RuleWish& wish,
                        std::int64_t now) {
    return writeNow([&](Database& database) {
        const std::int64_t latest = present(now);
        for (const std::string& handle : handles) {
            if (wish.ends) {
                revokeByHandleIn(database, owner, normalisedHandle(handle));
                continue;
            }
            const std::int64_t viewer = personIn(database, normalisedHandle(handle));
            if (viewer == 0 || viewer == owner) {
                continue;
            }
            Grant rule;
            rule.from = latest;
            if (const auto before = readGrant(database, owner, viewer); before && before->end() > latest) {
                // What was agreed with this viewer before stays, but for what the wish names.
                rule = *before;
            } else if (before) {
                // Of what is over no leave comes back by itself, and nothing from before is seen.
                rule.precision = before->precision;
            }
            rule.precision = wish.precision.value_or(rule.precision);
            rule.until = wish.until;
            rule.arrival = 0;
            rule.confirmed = latest;
            grantIn(database, owner, viewer, rule);
        }
    });
}

Confirmation Store::confirmGrant(std::int64_t owner, std::int64_t viewer, std::int64_t now) {
    Confirmation outcome = Confirmation::Failed;
    const bool good = writeNow([&](Database& database) {
        const std::int64_t latest = present(now);
        const auto grant = readGrant(database, owner, viewer);
        outcome = !grant || latest >= grant->end() ? Confirmation::IsNotThere
                  : grant->until                   ? Confirmation::HasAnEnd
                                                   : Confirmation::Kept;
        if (outcome == Confirmation::Kept) {
            changes(owner);
            changes(viewer);
            database.statement("UPDATE share SET confirmed = $3 WHERE owner = $1 AND viewer = $2 AND until IS NULL")
                .bind(owner)
                .bind(viewer)
                .bind(latest)
                .run();
        }
    });
    return good ? outcome : Confirmation::Failed;
}

std::vector<std::pair<std::string, Grant>> Store::grantsOf(std::int64_t owner) {
    const Reading reading(*this);
    std::vector<std::pair<std::string, Grant>> grants;
    auto row = reading->statement(
        "SELECT name, exactness, since, until, arrival, aloud, confirmed, fences FROM share JOIN person ON person.id = "
        "viewer "
        "WHERE owner = $1 ORDER BY name");
    row.bind(owner);
    while (row.next()) {
        grants.emplace_back(row.text(0), grantOf(row, 1));
    }
    return grants;
}

std::vector<Look> Store::looksAt(std::int64_t owner) {
    const Reading reading(*this);
    std::vector<Look> looks;
    auto row = reading->statement(
        "SELECT name, hour, asked FROM viewed JOIN person ON person.id = viewer WHERE owner = $1 "
        "ORDER BY hour DESC, name");
    row.bind(owner);
    while (row.next()) {
        looks.push_back({row.text(0), row.integer(1) * 3600, row.integer(2) != 0});
    }
    return looks;
}

}  // namespace ktr::server
