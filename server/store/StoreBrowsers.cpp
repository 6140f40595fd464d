// The part of the store that knows links which sign in, and browsers that are signed in. None of it is in a backup.
#include "server/store/Secret.h"
#include "server/store/Store.h"

namespace ktr::server {

void Store::addSignInIn(Database& database, std::int64_t person, std::string_view link, std::int64_t now) {
    const std::int64_t latest = present(now);
    database.statement("DELETE FROM sign_in WHERE until <= $1").bind(latest).run();
    database.statement("INSERT INTO sign_in (link, person, until) VALUES ($1, $2, $3)")
        .bindBytes(Secret::hash(link))
        .bind(person)
        .bind(latest + kSignInLasts)
        .run();
}

bool Store::addSignIn(std::int64_t person, std::string_view link, std::int64_t now) {
    return writeNow([&](Database& database) { addSignInIn(database, person, link, now); });
}

std::int64_t Store::spendLinkIn(Database& database, std::string_view link, std::int64_t latest) {
    const std::string hash = Secret::hash(link);
    std::int64_t person = 0;
    {
        auto row = database.statement("SELECT person FROM sign_in WHERE link = $1 AND until > $2");
        row.bindBytes(hash).bind(latest);
        person = row.next() ? row.integer(0) : 0;
    }
    database.statement("DELETE FROM sign_in WHERE link = $1").bindBytes(hash).run();
    // Whoever deletes it has it: another process may have read it at the same moment.
    return database.changes() == 1 ? person : 0;
}

SignIn Store::signProgramIn(std::string_view link, std::string_view secret, std::int64_t now, std::string& person) {
    SignIn outcome = SignIn::Failed;
    const std::int64_t device = Secret::number();
    const bool good = device != 0 && writeNow([&](Database& database) {
                          outcome = SignIn::Spent;
                          const std::int64_t latest = present(now);
                          const std::int64_t owner = spendLinkIn(database, link, latest);
                          if (owner == 0) {
                              return;
                          }
                          {
                              auto row = database.statement("SELECT name FROM person WHERE id = $1");
                              row.bind(owner);
                              person = row.next() ? row.text(0) : "";
                          }
                          addDeviceIn(database, device, {owner, DeviceKind::Reader, secret, "", false}, latest);
                          outcome = SignIn::Done;
                      });
    return good ? outcome : SignIn::Failed;
}

SignIn Store::signIn(std::string_view link, std::string_view session, std::int64_t now) {
    SignIn outcome = SignIn::Failed;
    const std::int64_t browser = Secret::number();
    const bool good =
        browser != 0 && writeNow([&](Database& database) {
            outcome = SignIn::Spent;
            const std::int64_t latest = present(now);
            const std::int64_t person = spendLinkIn(database, link, latest);
            if (person == 0) {
                return;
            }
            database.statement("DELETE FROM browser WHERE until <= $1").bind(latest).run();
            database.statement("INSERT INTO browser (id, session, person, made, until) VALUES ($1, $2, $3, $4, $5)")
                .bind(browser)
                .bindBytes(Secret::hash(session))
                .bind(person)
                .bind(latest)
                .bind(latest + kBrowserLasts)
                .run();
            outcome = SignIn::Done;
        });
    return good ? outcome : SignIn::Failed;
}

std::optional<Browser> Store::browserOf(std::string_view session, std::int64_t now, bool& failed) {
    const std::int64_t latest = present(now);
    const Reading reading(*this);
    auto row = reading->statement("SELECT id, person, made, until FROM browser WHERE session = $1 AND until > $2");
    if (!row.bindBytes(Secret::hash(session)).bind(latest).next()) {
        failed = reading->failed();
        return std::nullopt;
    }
    return Browser{row.integer(0), row.integer(1), row.integer(2), row.integer(3)};
}

std::vector<Browser> Store::browsersOf(std::int64_t person, std::int64_t now) {
    const std::int64_t latest = present(now);
    const Reading reading(*this);
    std::vector<Browser> browsers;
    auto row = reading->statement(
        "SELECT id, person, made, until FROM browser WHERE person = $1 AND until > $2 ORDER BY made, id");
    row.bind(person).bind(latest);
    while (row.next()) {
        browsers.push_back({row.integer(0), row.integer(1), row.integer(2), row.integer(3)});
    }
    return browsers;
}

bool Store::endBrowser(std::int64_t person, std::int64_t browser) {
    return writeNow([&](Database& database) {
        database.statement("DELETE FROM browser WHERE person = $1 AND id = $2").bind(person).bind(browser).run();
    });
}

void Store::endBrowsersIn(Database& database, std::int64_t person) {
    database.statement("DELETE FROM browser WHERE person = $1").bind(person).run();
    database.statement("DELETE FROM sign_in WHERE person = $1").bind(person).run();
}

}  // namespace ktr::server
