#include "server/store/Store.h"

#include <algorithm>
#include <future>

#include "documents/AtomicFile.h"
#include "server/ingest/FixRules.h"
#include "server/store/Secret.h"

namespace ktr::server {

namespace {

/// Told by SQLite's `file` magic: this store and no other database.
constexpr const char* kSchemaText = R"(
PRAGMA application_id = 0x6b747273;
CREATE TABLE person (
    id INTEGER PRIMARY KEY, name TEXT NOT NULL UNIQUE, hidden INTEGER NOT NULL DEFAULT 0,
    shown_since INTEGER NOT NULL DEFAULT 0, retention INTEGER NOT NULL, made INTEGER NOT NULL) STRICT;
CREATE TABLE handle (
    text TEXT PRIMARY KEY, shown TEXT NOT NULL, place INTEGER NOT NULL,
    person INTEGER NOT NULL REFERENCES person ON DELETE CASCADE) STRICT, WITHOUT ROWID;
CREATE INDEX handle_person ON handle (person, place);
CREATE TABLE device (
    id INTEGER PRIMARY KEY, person INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, kind INTEGER NOT NULL,
    secret BLOB NOT NULL UNIQUE, key TEXT NOT NULL DEFAULT '', heard INTEGER, revoked INTEGER, made INTEGER NOT NULL,
    cards_sent BLOB NOT NULL DEFAULT x'') STRICT;
CREATE INDEX device_person ON device (person);
CREATE TABLE fix (
    person INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, time INTEGER NOT NULL, heard INTEGER NOT NULL,
    latitude REAL NOT NULL, longitude REAL NOT NULL, accuracy REAL, PRIMARY KEY (person, time)) STRICT, WITHOUT ROWID;
CREATE TABLE share (
    viewer INTEGER NOT NULL REFERENCES person ON DELETE CASCADE,
    owner INTEGER NOT NULL REFERENCES person ON DELETE CASCADE,
    exactness INTEGER NOT NULL, since INTEGER NOT NULL, until INTEGER, PRIMARY KEY (viewer, owner)) STRICT, WITHOUT ROWID;
CREATE INDEX share_owner ON share (owner);
CREATE TABLE viewed (
    owner INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, hour INTEGER NOT NULL,
    viewer INTEGER NOT NULL REFERENCES person ON DELETE CASCADE, asked INTEGER NOT NULL,
    PRIMARY KEY (owner, hour, viewer)) STRICT, WITHOUT ROWID;
CREATE TABLE clock (id INTEGER PRIMARY KEY CHECK (id = 1), latest INTEGER NOT NULL) STRICT;
INSERT INTO clock VALUES (1, 0);
PRAGMA user_version = 1;
)";

constexpr std::size_t kLargestBatch = 512;
/// More than this at a step makes those who post wait.
constexpr std::int64_t kPeopleAStep = 10;
constexpr std::int64_t kViewedRetention = std::int64_t{30} * 86400;

/// Empty when the file has our schema.
std::string prepare(Database& database, bool make) {
    std::int64_t version = 0;
    std::int64_t application = 0;
    if (auto row = database.statement("PRAGMA user_version"); row.next()) {
        version = row.integer(0);
    }
    if (auto row = database.statement("PRAGMA application_id"); row.next()) {
        application = row.integer(0);
    }
    if (database.failed()) {
        return database.complaint();
    }
    if (version == 0 && application == 0 && make) {
        database.execute("BEGIN IMMEDIATE");
        // Another process may have been here first.
        auto row = database.statement("SELECT count(*) FROM sqlite_schema");
        const bool isNew = row.next() && row.integer(0) == 0;
        if (isNew) {
            database.execute(kSchemaText);
        }
        database.execute("COMMIT");
        return database.failed() ? database.complaint() : isNew ? "" : prepare(database, false);
    }
    if (application != 0x6b747273) {
        return "is no store of this service";
    }
    if (version > Store::kSchema) {
        return "was written by a newer program: use that one";
    }
    return "";
}

}  // namespace

std::string Store::normalisedHandle(std::string_view handle) {
    std::string text;
    if (handle.find('@') != std::string_view::npos) {
        for (const char letter : handle) {
            text += letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
        }
        return text;
    }
    std::copy_if(handle.begin(), handle.end(), std::back_inserter(text),
                 [](char letter) { return letter == '+' || (letter >= '0' && letter <= '9'); });
    return text;
}

std::unique_ptr<Store> Store::open(const std::string& folder, bool make, std::string& complaint) {
    if (make) {
        if (auto failure = documents::AtomicFile::makeFolder(folder); !failure.empty()) {
            complaint = failure;
            return nullptr;
        }
    }
    const std::string file = folder + "/service.db";
    auto writing = Database::open(file, complaint);
    auto reading = writing ? Database::open(file, complaint) : nullptr;
    if (!reading) {
        return nullptr;
    }
    if (const std::string problem = prepare(*writing, make); !problem.empty()) {
        complaint = file + ": " + problem;
        return nullptr;
    }
    std::unique_ptr<Store> store(new Store(std::move(reading), std::move(writing)));
    return store;
}

Store::Store(std::unique_ptr<Database> reading, std::unique_ptr<Database> writing)
    : reading_(std::move(reading)), writing_(std::move(writing)) {
    if (auto row = reading_->statement("SELECT latest FROM clock"); row.next()) {
        latest_ = row.integer(0);
    }
    thread_ = std::thread([this] { writeAll(); });
}

Store::~Store() {
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        ending_ = true;
    }
    wake_.notify_all();
    thread_.join();
}

void Store::write(std::function<void(Database&)> work, Done done) {
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        waiting_.push_back({std::move(work), std::move(done)});
    }
    wake_.notify_all();
}

bool Store::writeNow(const std::function<void(Database&)>& work) {
    std::promise<bool> written;
    write(work, [&](bool good) { written.set_value(good); });
    return written.get_future().get();
}

void Store::writeAll() {
    for (;;) {
        std::deque<Work> batch;
        {
            std::unique_lock<std::mutex> lock(mutex_);
            wake_.wait(lock, [this] { return ending_ || !waiting_.empty(); });
            if (waiting_.empty()) {
                return;
            }
            const auto end = waiting_.begin() + static_cast<std::ptrdiff_t>(std::min(kLargestBatch, waiting_.size()));
            std::move(waiting_.begin(), end, std::back_inserter(batch));
            waiting_.erase(waiting_.begin(), end);
        }
        const bool good = commit(batch);
        for (const Work& work : batch) {
            if (work.done) {
                work.done(good);
            }
        }
    }
}

bool Store::commit(const std::deque<Work>& batch) {
    writing_->clear();
    writing_->execute("BEGIN IMMEDIATE");
    for (const Work& work : batch) {
        if (!writing_->failed()) {
            work.write(*writing_);
        }
    }
    std::int64_t latest = 0;
    {
        const std::lock_guard<std::mutex> lock(mutex_);
        latest = latest_;
    }
    writing_->statement("UPDATE clock SET latest = max(latest, ?)").bind(latest).run();
    if (!writing_->failed() && writing_->execute("COMMIT")) {
        return true;
    }
    writing_->clear();
    writing_->execute("ROLLBACK");
    return false;
}

std::int64_t Store::present(std::int64_t now) {
    const std::lock_guard<std::mutex> lock(mutex_);
    latest_ = std::max(latest_, now);
    return latest_;
}

void Store::keep(std::int64_t device, std::int64_t person, std::vector<Fix> fixes, std::int64_t now, Done done) {
    write(
        [=, all = std::move(fixes)](Database& database) {
            // In the same commit as the question whether the person hides: nothing of that time comes in, then or
            // later.
            for (const Fix& fix : all) {
                database
                    .statement(
                        "INSERT INTO fix SELECT ?1, ?2, ?3, ?4, ?5, ?6 FROM person WHERE id = ?1 AND hidden = 0 "
                        "AND shown_since <= ?2 ON CONFLICT DO NOTHING")
                    .bind(person)
                    .bind(fix.time)
                    .bind(fix.heard)
                    .bind(fix.latitude)
                    .bind(fix.longitude)
                    .bind(fix.accuracy)
                    .run();
            }
            database
                .statement(
                    "UPDATE device SET heard = ?2 WHERE id = ?1 AND "
                    "(SELECT hidden FROM person WHERE person.id = device.person) = 0")
                .bind(device)
                .bind(now)
                .run();
        },
        std::move(done));
}

void Store::hide(std::int64_t person, std::int64_t, Done done) {
    write(
        [=](Database& database) { database.statement("UPDATE person SET hidden = 1 WHERE id = ?").bind(person).run(); },
        std::move(done));
}

void Store::noteLooks(std::int64_t viewer, std::vector<std::int64_t> owners, bool asked, std::int64_t now, Done done) {
    write(
        [=, all = std::move(owners)](Database& database) {
            for (const std::int64_t owner : all) {
                database
                    .statement(
                        "INSERT INTO viewed VALUES (?, ?, ?, ?) ON CONFLICT DO UPDATE SET asked = max(asked, "
                        "excluded.asked)")
                    .bind(owner)
                    .bind(now / 3600)
                    .bind(viewer)
                    .bind(std::int64_t{asked})
                    .run();
            }
        },
        std::move(done));
}

void Store::noteCards(std::int64_t device, std::string hash, Done done) {
    write(
        [=, bytes = std::move(hash)](Database& database) {
            database.statement("UPDATE device SET cards_sent = ?2 WHERE id = ?1").bind(device).bindBytes(bytes).run();
        },
        std::move(done));
}

void Store::deleteOld(std::int64_t now, Done done) {
    write(
        [this, now](Database& database) {
            std::vector<std::pair<std::int64_t, std::int64_t>> people;
            {
                auto row = database.statement("SELECT id, retention FROM person WHERE id > ? ORDER BY id LIMIT ?");
                row.bind(lastSwept_).bind(kPeopleAStep);
                while (row.next()) {
                    people.emplace_back(row.integer(0), row.integer(1));
                }
            }
            for (const auto& [person, retention] : people) {
                database.statement("DELETE FROM fix WHERE person = ? AND time < ?")
                    .bind(person)
                    .bind(now - retention)
                    .run();
                database.statement("DELETE FROM viewed WHERE owner = ? AND hour < ?")
                    .bind(person)
                    .bind((now - kViewedRetention) / 3600)
                    .run();
            }
            lastSwept_ = people.size() < static_cast<std::size_t>(kPeopleAStep) ? 0 : people.back().first;
        },
        std::move(done));
}

std::optional<Device> Store::deviceOf(std::string_view secret, bool& failed) {
    const std::lock_guard<std::mutex> lock(readMutex_);
    reading_->clear();
    auto row = reading_->statement(
        "SELECT device.id, kind, person, name, hidden, key, cards_sent FROM device JOIN person ON person.id = person "
        "WHERE secret = ? AND revoked IS NULL");
    if (!row.bindBytes(Secret::hash(secret)).next()) {
        failed = reading_->failed();
        return std::nullopt;
    }
    return Device{row.integer(0),      static_cast<DeviceKind>(row.integer(1)),
                  row.integer(2),      row.text(3),
                  row.integer(4) != 0, row.text(5),
                  row.text(6)};
}

std::optional<std::int64_t> Store::personOf(std::string_view handle) {
    const std::lock_guard<std::mutex> lock(readMutex_);
    reading_->clear();
    auto row = reading_->statement("SELECT person FROM handle WHERE text = ?");
    return row.bind(std::string_view(normalisedHandle(handle))).next() ? std::optional(row.integer(0)) : std::nullopt;
}

std::vector<Person> Store::people() {
    const std::lock_guard<std::mutex> lock(readMutex_);
    reading_->clear();
    std::vector<Person> people;
    auto row = reading_->statement("SELECT id, name, hidden FROM person ORDER BY name");
    while (row.next()) {
        Person person{row.integer(0), row.text(1), {}, row.integer(2) != 0};
        auto handle = reading_->statement("SELECT shown FROM handle WHERE person = ? ORDER BY place");
        handle.bind(person.id);
        while (handle.next()) {
            person.handles.push_back(handle.text(0));
        }
        people.push_back(std::move(person));
    }
    return people;
}

std::optional<Person> Store::person(std::int64_t id) {
    const std::lock_guard<std::mutex> lock(readMutex_);
    reading_->clear();
    auto row = reading_->statement("SELECT id, name, hidden FROM person WHERE id = ?");
    if (!row.bind(id).next()) {
        return std::nullopt;
    }
    Person person{row.integer(0), row.text(1), {}, row.integer(2) != 0};
    auto handle = reading_->statement("SELECT shown FROM handle WHERE person = ? ORDER BY place");
    handle.bind(id);
    while (handle.next()) {
        person.handles.push_back(handle.text(0));
    }
    return person;
}

std::optional<Person> Store::personNamed(std::string_view name) {
    std::int64_t id = 0;
    {
        const std::lock_guard<std::mutex> lock(readMutex_);
        reading_->clear();
        auto row = reading_->statement("SELECT id FROM person WHERE name = ?");
        if (!row.bind(name).next()) {
            return std::nullopt;
        }
        id = row.integer(0);
    }
    return person(id);
}

Sharing Store::sharingOf(Database::Run& row, int firstColumn) {
    Sharing sharing;
    sharing.hidden = row.integer(firstColumn) != 0;
    sharing.shownSince = row.integer(firstColumn + 1);
    sharing.retention = row.integer(firstColumn + 2);
    if (row.maybeInteger(firstColumn + 3)) {
        sharing.grant = Grant{static_cast<Precision>(row.integer(firstColumn + 3)), row.integer(firstColumn + 4),
                              row.maybeInteger(firstColumn + 5)};
    }
    return sharing;
}

void Store::readFixes(std::int64_t owner, Sharing& sharing) {
    auto row = reading_->statement(
        "SELECT time, heard, latitude, longitude, accuracy FROM fix WHERE person = ? AND time >= ? ORDER BY time");
    row.bind(owner).bind(std::max(sharing.grant->from, sharing.shownSince));
    while (row.next()) {
        sharing.fixes.push_back({row.integer(0), row.integer(1), row.real(2), row.real(3), row.maybeReal(4)});
    }
}

std::optional<Sharing> Store::sharing(std::int64_t viewer, std::int64_t owner) {
    const std::int64_t latest = present(0);
    const std::lock_guard<std::mutex> lock(readMutex_);
    reading_->clear();
    auto row = reading_->statement(
        "SELECT hidden, shown_since, retention, exactness, since, until FROM person "
        "LEFT JOIN share ON share.owner = person.id AND share.viewer = ? WHERE person.id = ?");
    if (!row.bind(viewer).bind(owner).next()) {
        return std::nullopt;
    }
    Sharing sharing = sharingOf(row, 0);
    sharing.latest = latest;
    if (sharing.grant && !sharing.hidden) {
        readFixes(owner, sharing);
    }
    return sharing;
}

std::vector<Friend> Store::friendsOf(std::int64_t viewer) {
    const std::int64_t latest = present(0);
    const std::lock_guard<std::mutex> lock(readMutex_);
    reading_->clear();
    std::vector<Friend> friends;
    auto row = reading_->statement(
        "SELECT person.id, name, hidden, shown_since, retention, exactness, since, until FROM share "
        "JOIN person ON person.id = share.owner WHERE share.viewer = ? ORDER BY name");
    row.bind(viewer);
    while (row.next()) {
        Friend one{row.integer(0), row.text(1), sharingOf(row, 2)};
        one.sharing.latest = latest;
        if (!one.sharing.hidden) {
            readFixes(one.person, one.sharing);
        }
        friends.push_back(std::move(one));
    }
    return friends;
}

}  // namespace ktr::server
