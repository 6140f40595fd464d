// The part of the store that knows faces, and which phone was told of whom.
#include "server/store/Secret.h"
#include "server/store/Store.h"

namespace ktr::server {

void Store::keepFace(std::int64_t person, std::string picture, Done done) {
    write(
        [person, bytes = std::move(picture)](Database& database) {
            database
                .statement(
                    "INSERT INTO face (person, picture, hash) SELECT $1, $2, $3 FROM person WHERE id = $1 AND "
                    "hidden = 0 {shared lock} ON CONFLICT (person) DO UPDATE SET picture = excluded.picture, "
                    "hash = excluded.hash")
                .bind(person)
                .bindBytes(bytes)
                .bindBytes(Secret::hash(bytes))
                .run();
        },
        std::move(done));
}

bool Store::setFace(std::int64_t person, const std::string& picture) {
    return writeNow([&](Database& database) {
        database.statement("DELETE FROM face WHERE person = $1").bind(person).run();
        if (!picture.empty()) {
            database.statement("INSERT INTO face (person, picture, hash) VALUES ($1, $2, $3)")
                .bind(person)
                .bindBytes(picture)
                .bindBytes(Secret::hash(picture))
                .run();
        }
    });
}

std::optional<std::string> Store::face(std::int64_t person) {
    const Reading reading(*this);
    auto row = reading->statement("SELECT picture FROM face WHERE person = $1");
    return row.bind(person).next() ? std::optional(row.text(0)) : std::nullopt;
}

std::map<std::int64_t, CardState> Store::cards(std::int64_t device, std::int64_t viewer) {
    const Reading reading(*this);
    std::map<std::int64_t, CardState> cards;
    auto row = reading->statement(
        "SELECT share.owner, face.hash, card.hash, card.sent, card.post FROM share "
        "LEFT JOIN face ON face.person = share.owner "
        "LEFT JOIN card ON card.owner = share.owner AND card.device = $1 WHERE share.viewer = $2");
    row.bind(device).bind(viewer);
    while (row.next()) {
        cards[row.integer(0)] = {row.text(1),
                                 {row.text(2), row.maybeInteger(3).value_or(0), row.maybeInteger(4).value_or(0)}};
    }
    return cards;
}

SentCard Store::sentCard(std::int64_t device, std::int64_t owner) {
    const Reading reading(*this);
    auto row = reading->statement("SELECT hash, sent, post FROM card WHERE device = $1 AND owner = $2");
    return row.bind(device).bind(owner).next() ? SentCard{row.text(0), row.integer(1), row.integer(2)} : SentCard{};
}

void Store::noteCards(std::int64_t device, std::map<std::int64_t, SentCard> sent, Done done) {
    write(
        [device, all = std::move(sent)](Database& database) {
            for (const auto& [owner, card] : all) {
                database
                    .statement(
                        "INSERT INTO card (device, owner, hash, sent, post) VALUES ($1, $2, $3, $4, $5) "
                        "ON CONFLICT (device, owner) DO UPDATE SET hash = excluded.hash, sent = excluded.sent, "
                        "post = excluded.post")
                    .bind(device)
                    .bind(owner)
                    .bindBytes(card.hash)
                    .bind(card.time)
                    .bind(card.post)
                    .run();
            }
        },
        std::move(done));
}

}  // namespace ktr::server
