// The part of the store that decides what is kept for how long, and what leaves it as a whole. Calls wait for the disk.
#include <algorithm>

#include "server/ingest/Base64.h"
#include "server/store/Secret.h"
#include "server/store/Store.h"
#include "server/store/StoreCopy.h"
#include "server/store/StoreTables.h"

namespace ktr::server {

using platform::Dictionary;
using platform::Value;

namespace {

Value jsonOf(const DatabaseValue& value) {
    if (value.isNone) {
        return nullptr;
    }
    switch (value.type) {
        case DatabaseValue::Type::Integer:
            return value.integer;
        case DatabaseValue::Type::Real:
            return value.real;
        case DatabaseValue::Type::Text:
            return value.text;
        case DatabaseValue::Type::Bytes:
            return Base64::encode(value.text);
    }
    return nullptr;
}

template <class Words>
bool contains(const Words& words, const std::string& word) {
    return std::find(words.begin(), words.end(), word) != words.end();
}

std::string nameOfPerson(Database& database, std::int64_t id) {
    auto row = database.statement("SELECT name FROM person WHERE id = $1");
    return row.bind(id).next() ? row.text(0) : std::string();
}

std::vector<std::int64_t> numbersOfAll(Database& database) {
    std::vector<std::int64_t> numbers;
    auto row = database.statement("SELECT id FROM person");
    while (row.next()) {
        numbers.push_back(row.integer(0));
    }
    return numbers;
}

/// The rows of a table that are about a person: others by their names, without what opens something.
Value::Array rowsOf(Database& database, const StoreTable& table, std::int64_t person) {
    std::string sql = "SELECT * FROM " + std::string(table.name);
    for (std::size_t i = 0; i < table.people.size() && !table.people[i].empty(); ++i) {
        sql += (i == 0 ? " WHERE " : " OR ") + std::string(table.people[i]) + " = $1";
    }
    Value::Array rows;
    auto row = database.statement(sql.c_str());
    row.bind(person);
    while (row.next()) {
        Dictionary fields;
        for (int i = 0; i < row.columns(); ++i) {
            const std::string name = row.nameOf(i);
            if (contains(table.secrets, name)) {
                continue;
            }
            fields.set(name, contains(table.people, name) ? Value(nameOfPerson(database, row.integer(i)))
                                                          : jsonOf(row.value(i)));
        }
        rows.emplace_back(std::move(fields));
    }
    return rows;
}

}  // namespace

std::string Store::backup(const std::string& file) {
    const Reading reading(*this);
    return StoreCopy::write(*reading, file);
}

std::string Store::restore(const std::string& file, const std::string& folder, std::int64_t now) {
    const StoreCopy::Opened backup(file, folder);
    if (!backup.complaint().empty()) {
        return backup.complaint();
    }
    std::string complaint;
    const bool good = writeNow([&](Database& database) {
        changesEverything();
        StoreCopy::restore(database, backup.database(), now);
        for (const std::int64_t person : numbersOfAll(database)) {
            hideIn(database, person);
        }
        database.settle();
        complaint = database.complaint();
    });
    return good ? "" : file + ": cannot be restored: " + (complaint.empty() ? "nothing was changed" : complaint);
}

bool Store::forget(std::int64_t person, std::int64_t now) {
    const bool good = writeNow([&](Database& database) {
        changesEverything();
        std::string identity;
        {
            auto row = database.statement("SELECT identity FROM person WHERE id = $1");
            if (!row.bind(person).next()) {
                return database.note("there is nobody with this number");
            }
            identity = row.text(0);
        }
        database.statement("INSERT INTO forgotten (hash, made) VALUES ($1, $2) ON CONFLICT DO NOTHING")
            .bindBytes(Secret::hash(identity))
            .bind(now)
            .run();
        // What others asked goes by handle.
        database.statement("DELETE FROM ask WHERE handle IN (SELECT text FROM handle WHERE person = $1)")
            .bind(person)
            .run();
        // All that refers to a person goes with it.
        database.statement("DELETE FROM person WHERE id = $1").bind(person).run();
    });
    if (good) {
        // At once, not with the next time that happens by itself.
        const Reading reading(*this);
        reading->scrub();
    }
    return good;
}

std::optional<Dictionary> Store::everythingOf(std::int64_t person) {
    const Reading reading(*this);
    Dictionary everything;
    if (!reading->beginReading()) {
        return std::nullopt;
    }
    for (const StoreTable& table : StoreTables::all()) {
        if (!table.people[0].empty()) {
            everything.set(std::string(table.name), rowsOf(*reading, table, person));
        }
    }
    const bool good = !reading->failed();
    reading->rollback();
    return good ? std::optional(everything) : std::nullopt;
}

bool Store::setRetention(std::int64_t person, const Retention& retention, std::int64_t now) {
    return writeNow([&](Database& database) {
        database.statement("UPDATE person SET retention = $2, looks_retention = $3 WHERE id = $1")
            .bind(person)
            .bind(retention.fixes)
            .bind(retention.looks)
            .run();
        deleteOldOf(database, person, retention, now);
        changes(person);
    });
}

std::optional<Retention> Store::retention(std::int64_t person) {
    const Reading reading(*this);
    auto row = reading->statement("SELECT retention, looks_retention FROM person WHERE id = $1");
    return row.bind(person).next() ? std::optional(Retention{row.integer(0), row.integer(1)}) : std::nullopt;
}

int Store::confirm(std::int64_t person) {
    int confirmed = 0;
    const bool good = writeNow([&](Database& database) {
        database.statement("UPDATE device SET suspended = 0 WHERE person = $1 AND suspended = 1").bind(person).run();
        confirmed = database.changes();
        changes(person);
    });
    return good ? confirmed : 0;
}

}  // namespace ktr::server
