// The part of the store that knows who would like to see whom.
#include "server/store/Store.h"

namespace ktr::server {

AskOutcome Store::askToSee(std::int64_t asker, const std::vector<std::string>& handles, std::int64_t now) {
    bool isTooMany = false;
    const bool good = writeNow([&](Database& database) {
        {
            auto row = database.statement("SELECT count(*) FROM ask WHERE asker = $1 AND time > $2");
            row.bind(asker).bind(now - kAskAgainAfter).next();
            isTooMany = row.integer(0) + static_cast<std::int64_t>(handles.size()) > kMostAsks;
        }
        if (isTooMany) {
            return;
        }
        for (const std::string& handle : handles) {
            database
                .statement(
                    "INSERT INTO ask (asker, handle, time, answered) VALUES ($1, $2, $3, 0) "
                    "ON CONFLICT (asker, handle) DO UPDATE SET time = excluded.time, answered = 0 "
                    "WHERE ask.time <= excluded.time - $4")
                .bind(asker)
                .bind(std::string_view(normalisedHandle(handle)))
                .bind(now)
                .bind(kAskAgainAfter)
                .run();
        }
    });
    return !good ? AskOutcome::Failed : isTooMany ? AskOutcome::TooMany : AskOutcome::Asked;
}

std::optional<std::vector<AskedBy>> Store::askersOf(std::int64_t person, std::int64_t now) {
    const Reading reading(*this);
    std::vector<AskedBy> askers;
    {
        // Somebody may have been asked by two of their handles.
        auto row = reading->statement(
            "SELECT asker, name, max(time), COALESCE((SELECT text FROM handle WHERE handle.person = asker "
            "ORDER BY place LIMIT 1), '') FROM ask JOIN person ON person.id = asker "
            "WHERE ask.handle IN (SELECT text FROM handle WHERE handle.person = $1) AND answered = 0 AND asker <> $1 "
            "AND time > $2 AND NOT EXISTS (SELECT 1 FROM share WHERE share.owner = $1 AND share.viewer = asker "
            "AND (share.until IS NULL OR share.until > $3)) GROUP BY asker, name ORDER BY max(time) DESC, name");
        row.bind(person).bind(now - kAsksKept).bind(now);
        while (row.next()) {
            askers.push_back({row.integer(0), row.text(1), row.text(3), row.integer(2)});
        }
    }
    return reading->failed() ? std::nullopt : std::optional(std::move(askers));
}

bool Store::endAsk(std::int64_t person, std::int64_t asker) {
    return writeNow([&](Database& database) {
        database
            .statement(
                "UPDATE ask SET answered = 1 WHERE asker = $2 AND handle IN (SELECT text FROM handle WHERE person = "
                "$1)")
            .bind(person)
            .bind(asker)
            .run();
    });
}

}  // namespace ktr::server
