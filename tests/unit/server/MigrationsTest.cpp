#include "server/store/Migrations.h"

#include <gtest/gtest.h>
#include <libpq-fe.h>
#include <sqlite3.h>
#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <thread>

#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Fix;
using server::Grant;
using server::Migrations;
using server::Precision;
using server::Store;
using server::StoreAddress;

namespace {

/// What the first version made, word for word, with somebody in it.
constexpr const char* kFirst = R"(
PRAGMA journal_mode = WAL;
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
INSERT INTO person VALUES (1, 'ann', 0, 1763750000, 172800, 1763740000), (2, 'otto', 1, 0, 172800, 1763740000);
INSERT INTO handle VALUES ('ann@x.example', 'Ann@x.example', 1, 1);
INSERT INTO device VALUES (1, 1, 0, x'2c26b46b68ffc68ff99b453c1d30413413422d706483bfa0f98a5e886266e7ae', '', 1763750000, NULL,
    1763740000, x'00ff');
INSERT INTO fix VALUES (1, 1763759000, 1763759001, 50.25, -3.5, 12.5), (1, 1763759100, 1763759101, 50.5, -3.5, NULL);
INSERT INTO share VALUES (2, 1, 2, 1763740000, 1763800000);
INSERT INTO viewed VALUES (1, 489933, 2, 1);
UPDATE clock SET latest = 1763759200;
)";

void run(const std::string& file, const char* sql) {
    sqlite3* handle = nullptr;
    ASSERT_EQ(sqlite3_open(file.c_str(), &handle), SQLITE_OK);
    EXPECT_EQ(sqlite3_exec(handle, sql, nullptr, nullptr, nullptr), SQLITE_OK) << sqlite3_errmsg(handle);
    sqlite3_close(handle);
}

class FileStoreTest : public ::testing::Test {
  protected:
    std::string file() const { return (folder_.path() / "service.db").string(); }
    std::unique_ptr<Store> open(std::string& complaint, bool make = false) const {
        return Store::open({folder_.path().string()}, make, complaint);
    }
    TemporaryFolder folder_;
};

}  // namespace

TEST_F(FileStoreTest, StoreOfTheFirstVersion_IsBroughtToToday_WithAllThatIsInIt) {
    run(file(), kFirst);
    std::string complaint;
    auto store = open(complaint);
    ASSERT_TRUE(store) << complaint;
    bool failed = false;
    const auto phone = store->deviceOf("foo", failed);
    ASSERT_TRUE(phone);
    EXPECT_EQ(phone->person, 1);
    EXPECT_EQ(store->cards(phone->id, 2).size(), 1U) << "ann's, who shares with otto";
    EXPECT_EQ(store->cards(phone->id, 2).at(1), server::CardState()) << "each phone is told anew";
    EXPECT_EQ(store->personOf("ANN@x.example"), 1);
    EXPECT_TRUE(store->person(2)->hidden);
    const auto sharing = store->sharing(2, 1);
    ASSERT_TRUE(sharing && sharing->grant);
    EXPECT_EQ(sharing->grant->precision, Precision::Town);
    EXPECT_EQ(sharing->grant->until, 1763800000);
    EXPECT_EQ(sharing->shownSince, 1763750000);
    EXPECT_EQ(sharing->retention, 172800);
    EXPECT_EQ(sharing->latest, 1763759200);
    EXPECT_EQ(sharing->fixes, (std::vector<Fix>{{1763759000, 1763759001, 50.25, -3.5, 12.5},
                                                {1763759100, 1763759101, 50.5, -3.5, std::nullopt}}));
    EXPECT_EQ(store->check(), "");
    // And again: nothing is left to do.
    store = open(complaint);
    EXPECT_TRUE(store) << complaint;
}

TEST_F(FileStoreTest, NewerStore_AndForeignFiles_AreRefusedWithASentence) {
    std::string complaint;
    ASSERT_TRUE(open(complaint, true)) << complaint;
    struct stat facts {};
    ASSERT_EQ(::stat(file().c_str(), &facts), 0);
    EXPECT_EQ(facts.st_mode & 0777U, 0600U);
    run(file(), ("PRAGMA user_version = " + std::to_string(Migrations::latest() + 1)).c_str());
    EXPECT_EQ(open(complaint, true), nullptr);
    EXPECT_EQ(complaint, file() + ": was written by a newer program: use that one");

    std::filesystem::remove(file());
    run(file(), "CREATE TABLE other (x)");
    EXPECT_EQ(open(complaint, true), nullptr);
    EXPECT_EQ(complaint, file() + ": is no store of this service");

    std::ofstream(file(), std::ios::trunc) << std::string(5000, 'x');
    complaint.clear();
    EXPECT_EQ(open(complaint, true), nullptr);
    EXPECT_NE(complaint, "");
    std::filesystem::remove(file());
    complaint.clear();
    EXPECT_EQ(open(complaint), nullptr) << "an empty store only where one is made";
    EXPECT_EQ(complaint, file() + ": is empty");
    for (const char* kind : {"folder", "pipe"}) {
        std::filesystem::remove(file());
        ASSERT_EQ(kind[0] == 'f' ? ::mkdir(file().c_str(), 0700) : ::mkfifo(file().c_str(), 0600), 0);
        complaint.clear();
        EXPECT_EQ(open(complaint, true), nullptr) << kind;
        EXPECT_NE(complaint, "");
    }
    complaint.clear();
    EXPECT_EQ(Store::open({"/not/there"}, false, complaint), nullptr);
    EXPECT_NE(complaint, "");
}

TEST_F(FileStoreTest, StoreInMemory_IsOneStore_AndGoneAfterwards) {
    std::string complaint;
    const StoreAddress address = StoreAddress::inMemory();
    auto store = Store::open(address, true, complaint);
    ASSERT_TRUE(store) << complaint;
    EXPECT_TRUE(store->addPerson("ann", {"ann@x.example"}, 1));
    EXPECT_TRUE(store->personOf("ann@x.example"));
    const auto other = Store::open(StoreAddress::inMemory(), true, complaint);
    ASSERT_TRUE(other) << complaint;
    EXPECT_TRUE(other->people().empty());
    store.reset();
    store = Store::open(address, true, complaint);
    ASSERT_TRUE(store) << complaint;
    EXPECT_TRUE(store->people().empty());
}

/// Stores as each version left them, of either kind.
class StoreOfEveryVersion : public ::testing::TestWithParam<bool> {
  protected:
    void SetUp() override {
        if (GetParam() && PrivatePostgres::shared() == nullptr) {
            GTEST_SKIP() << "needs a PostgreSQL server: KTR_LONG_TESTS=1 starts one";
        }
    }
    StoreAddress newAddress() {
        const std::string folder = (folder_.path() / std::to_string(++stores_)).string();
        return GetParam() ? StoreAddress{PrivatePostgres::shared()->newStore()}
                          : StoreAddress{std::filesystem::create_directory(folder) ? folder : ""};
    }
    void run(const StoreAddress& address, const std::string& sql) const {
        ASSERT_NE(sql, "");
        if (!GetParam()) {
            return test::run(address.text + "/service.db", sql.c_str());
        }
        PGconn* const connection = ::PQconnectdb(address.text.c_str());
        PGresult* const result = ::PQexec(connection, ("BEGIN;" + sql + ";COMMIT").c_str());
        EXPECT_EQ(::PQresultStatus(result), PGRES_COMMAND_OK) << ::PQresultErrorMessage(result);
        ::PQclear(result);
        ::PQfinish(connection);
    }
    /// What made a store of the version before one of this version.
    std::string step(int version) const {
        if (version == 1 && !GetParam()) {
            return kFirst;
        }
        const std::ifstream stream(std::string(KTR_TEST_DATA) + "/unit/server/stores/" +
                                   (GetParam() ? "postgresql/" : "") + "step" + std::to_string(version) + ".sql");
        std::ostringstream text;
        text << stream.rdbuf();
        return text.str();
    }
    /// All columns of all tables, and all indexes, a line each.
    std::string form(const StoreAddress& address) const {
        std::string complaint;
        const auto database = address.connect(complaint);
        EXPECT_TRUE(database) << complaint;
        auto row = database->statement(
            GetParam() ? "SELECT table_name || ' ' || column_name || ' ' || data_type || ' ' || is_nullable || ' ' || "
                         "COALESCE(collation_name, '') FROM information_schema.columns WHERE table_schema = "
                         "current_schema() UNION SELECT tablename || ' ' || replace(indexdef, current_schema() || '.', "
                         "'') FROM pg_indexes WHERE schemaname = current_schema() ORDER BY 1"
                       : "SELECT m.name || ' ' || c.name || ' ' || c.type FROM sqlite_schema m, "
                         "pragma_table_info(m.name) c WHERE m.type = 'table' UNION SELECT tbl_name || ' ' || sql FROM "
                         "sqlite_schema WHERE type = 'index' AND sql IS NOT NULL ORDER BY 1");
        std::string text;
        while (row.next()) {
            text += row.text(0) + "\n";
        }
        EXPECT_FALSE(database->failed()) << database->complaint();
        return text;
    }
    TemporaryFolder folder_;
    int stores_ = 0;
};

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreOfEveryVersion, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreOfEveryVersion, ::testing::Values(true));

TEST_P(StoreOfEveryVersion, IsBroughtToToday_WithAllThatIsInIt) {
    std::string complaint;
    const StoreAddress fresh = newAddress();
    ASSERT_TRUE(Store::open(fresh, true, complaint)) << complaint;
    const std::string today = form(fresh);
    EXPECT_NE(today.find("ask_handle"), std::string::npos) << today;
    for (int version = 1; version <= Migrations::latest(); ++version) {
        const StoreAddress address = newAddress();
        for (int one = 1; one <= version; ++one) {
            run(address, step(one));
        }
        if (version == Migrations::latest()) {
            EXPECT_EQ(form(address), today) << "what is kept here is what this version made";
        }
        const auto store = Store::open(address, false, complaint);
        ASSERT_TRUE(store) << version << ": " << complaint;
        EXPECT_EQ(form(address), today) << version;
        EXPECT_EQ(store->check(), "") << version;
        bool failed = false;
        EXPECT_TRUE(store->deviceOf("foo", failed)) << version;
        EXPECT_EQ(store->personOf("ANN@x.example"), 1) << version;
        EXPECT_TRUE(store->person(2)->hidden) << version;
        const auto sharing = store->sharing(2, 1);
        ASSERT_TRUE(sharing && sharing->grant) << version;
        EXPECT_EQ(sharing->grant->until, 1763800000) << version;
        EXPECT_EQ(sharing->fixes, (std::vector<Fix>{{1763759000, 1763759001, 50.25, -3.5, 12.5},
                                                    {1763759100, 1763759101, 50.5, -3.5, std::nullopt}}));
        EXPECT_EQ(sharing->grant->aloud, version >= 3);
        EXPECT_EQ(sharing->grant->fences, version >= 6);
        EXPECT_EQ(store->browsersOf(1, 1763760000).size(), version >= 2 ? 1U : 0U);
        EXPECT_EQ(store->person(1)->zone, version >= 3 ? "Europe/Berlin" : "");
        EXPECT_EQ(store->placesOf(1).size(), version >= 3 ? 1U : 0U);
        EXPECT_EQ(store->retention(1)->looks, version >= 4 ? 86400 : 30 * 86400);
        EXPECT_EQ(store->face(1).has_value(), version >= 5);
        EXPECT_TRUE(store->everythingOf(1)->find("fix_wish")) << version;
        EXPECT_EQ(store->fencesAbout(1).value().size(), version >= 6 ? 1U : 0U);
        EXPECT_EQ(store->askersOf(1, 1763760000).value().size(), version >= 9 ? 1U : 0U);
        // And what was added since works.
        EXPECT_TRUE(store->addPerson("new", {"new@x.example"}, 1763760000)) << version;
        EXPECT_EQ(store->askToSee(store->personNamed("new")->id, {"ann@x.example"}, 1763760000),
                  server::AskOutcome::Asked);
        EXPECT_EQ(store->askersOf(1, 1763760000).value().size(), version >= 9 ? 2U : 1U);
    }
}

class StoreMigrations : public StoreContract {};

TEST_P(StoreMigrations, NewerStore_IsRefusedWithASentence) {
    store_.reset();
    std::string complaint;
    const auto database = address_.connect(complaint);
    ASSERT_TRUE(database) << complaint;
    database->setSchema(Migrations::latest() + 1);
    ASSERT_FALSE(database->failed());
    EXPECT_EQ(Store::open(address_, true, complaint), nullptr);
    EXPECT_EQ(complaint, address_.name() + ": was written by a newer program: use that one");
}

TEST_P(StoreMigrations, ManyProcessesAtOnce_MakeOneStore) {
    const StoreAddress address{GetParam() ? PrivatePostgres::shared()->newStore() : address_.text + "-new"};
    std::vector<std::thread> threads;
    std::array<std::string, 6> complaints;
    std::array<bool, 6> opened{};
    for (std::size_t i = 0; i < complaints.size(); ++i) {
        threads.emplace_back([&, i] { opened[i] = Store::open(address, true, complaints[i]) != nullptr; });
    }
    for (std::size_t i = 0; i < complaints.size(); ++i) {
        threads[i].join();
        EXPECT_TRUE(opened[i]) << complaints[i];
    }
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreMigrations, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreMigrations, ::testing::Values(true));

}  // namespace ktr::test
