#include <gtest/gtest.h>
#include <sqlite3.h>
#include <sys/stat.h>

#include <algorithm>
#include <set>
#include <thread>

#include "platform/base/Json.h"
#include "server/store/Secret.h"
#include "server/store/StoreTables.h"
#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Database;
using server::DeviceKind;
using server::Fix;
using server::Precision;
using server::Retention;
using server::Store;
using server::StoreTable;
using server::StoreTables;

class StoreKeeping : public StoreContract {
  protected:
    std::string file(const char* name = "backup") const { return (folder_.path() / name).string(); }
    std::string restore(const std::string& from) { return store_->restore(from, folder_.path().string(), kNow + 5000); }
    std::vector<std::string> names() {
        std::vector<std::string> names;
        for (const server::Person& person : store_->people()) {
            names.push_back(person.name);
        }
        return names;
    }
    std::int64_t count(const std::string& sql) {
        std::string complaint;
        const auto database = address_.connect(complaint);
        auto row = database->statement(sql.c_str());
        EXPECT_TRUE(row.next()) << sql << database->complaint();
        return row.integer(0);
    }
    /// Nothing but the folder of the store and these files.
    std::vector<std::string> filesBeside() const {
        std::vector<std::string> found;
        for (const auto& entry : std::filesystem::directory_iterator(folder_.path())) {
            if (entry.path().filename() != "data") {
                found.push_back(entry.path().filename().string());
            }
        }
        std::sort(found.begin(), found.end());
        return found;
    }
    static void fill(Store& store, std::int64_t ann, std::int64_t otto, std::int64_t phone) {
        ASSERT_TRUE(store.addDevice(otto, DeviceKind::Reader, "otto's", "", kNow));
        ASSERT_TRUE(finished([&](auto done) { store.keep(phone, ann, {at(kNow - 5, 12.34567891)}, kNow, done); }));
        ASSERT_TRUE(finished([&](auto done) { store.noteLooks(otto, {ann}, true, kNow, done); }));
        ASSERT_TRUE(store.addSignIn(ann, "a link", kNow));
        ASSERT_TRUE(store.addSignIn(ann, "another link", kNow));
        ASSERT_EQ(store.signIn("a link", "a session", kNow), server::SignIn::Done);
    }
};

TEST_P(StoreKeeping, EveryTable_IsNamedWithItsPeople) {
    std::string complaint;
    const auto database = address_.connect(complaint);
    const char* tables = GetParam() ? "SELECT tablename FROM pg_tables WHERE schemaname = current_schema() "
                                      "AND tablename <> 'ktr_store'"
                                    : "SELECT name FROM sqlite_schema WHERE type = 'table'";
    std::set<std::string> found;
    std::set<std::string> named;
    {
        auto row = database->statement(tables);
        while (row.next()) {
            found.insert(row.text(0));
        }
    }
    for (const StoreTable& table : StoreTables::all()) {
        named.insert(std::string(table.name));
        if (GetParam()) {
            continue;
        }
        // Whatever refers to a person goes with the person, and is known to.
        auto row = database->statement("SELECT * FROM pragma_foreign_key_list($1)");
        row.bind(table.name);
        while (row.next()) {
            if (row.text(2) == "person") {
                EXPECT_EQ(std::count(table.people.begin(), table.people.end(), row.text(3)), 1)
                    << table.name << "." << row.text(3);
                EXPECT_EQ(row.text(6), "CASCADE") << table.name << "." << row.text(3);
            }
        }
    }
    EXPECT_EQ(named, found);
}

TEST_P(StoreKeeping, Backup_IsWithoutPlacesLooksAndSessions_AndNothingLiesBesideIt) {
    fill(*store_, ann_, otto_, phone_);
    ASSERT_EQ(store_->backup(file()), "");
    EXPECT_EQ(filesBeside(), std::vector<std::string>{"backup"});
    struct stat facts {};
    ASSERT_EQ(::stat(file().c_str(), &facts), 0);
    EXPECT_EQ(facts.st_mode & 0777U, 0600U);
    sqlite3* handle = nullptr;
    ASSERT_EQ(sqlite3_open_v2(file().c_str(), &handle, SQLITE_OPEN_READONLY, nullptr), SQLITE_OK);
    for (const StoreTable& table : StoreTables::all()) {
        sqlite3_stmt* statement = nullptr;
        const std::string sql = "SELECT count(*) FROM " + std::string(table.name);
        ASSERT_EQ(sqlite3_prepare_v2(handle, sql.c_str(), -1, &statement, nullptr), SQLITE_OK) << table.name;
        ASSERT_EQ(sqlite3_step(statement), SQLITE_ROW);
        EXPECT_EQ(sqlite3_column_int64(statement, 0), table.inBackup ? count(sql) : 0) << table.name;
        sqlite3_finalize(statement);
    }
    sqlite3_close(handle);
    for (const char* name : {"fix", "viewed", "sign_in", "browser"}) {
        EXPECT_GT(count(std::string("SELECT count(*) FROM ") + name), 0) << name << ": the store itself keeps it";
    }
}

TEST_P(StoreKeeping, Backup_GoesOnWhileOthersWrite) {
    std::atomic<bool> ending = false;
    std::atomic<int> written = 0;
    std::thread poster([&] {
        for (int i = 0; !ending; ++i) {
            written += keep({at(kNow - 100000 + i)}) ? 1 : 0;
        }
    });
    for (int i = 0; i < 3; ++i) {
        const int before = written;
        EXPECT_EQ(store_->backup(file()), "");
        while (written <= before) {
            std::this_thread::yield();
        }
    }
    ending = true;
    poster.join();
    EXPECT_EQ(seenByOtto().size(), 0U) << "from before the grant";
    EXPECT_EQ(count("SELECT count(*) FROM fix"), written);
}

TEST_P(StoreKeeping, BackupThatCannotBeWritten_SaysSo_AndLeavesNothing) {
    ASSERT_EQ(::mkdir(file("folder").c_str(), 0700), 0);
    ASSERT_EQ(::mkfifo(file("pipe").c_str(), 0600), 0);
    for (const char* name : {"folder", "pipe", "missing/backup"}) {
        const std::string complaint = store_->backup(file(name));
        EXPECT_EQ(complaint.rfind(file(name) + ": ", 0), 0U) << complaint;
    }
    EXPECT_EQ(filesBeside(), (std::vector<std::string>{"folder", "pipe"}));
}

TEST_P(StoreKeeping, Restore_BringsEverybodyBack_HiddenAndWithReadersThatWait) {
    fill(*store_, ann_, otto_, phone_);
    store_->present(kNow + 700);
    ASSERT_TRUE(keep({}));
    ASSERT_EQ(store_->backup(file()), "");
    ASSERT_TRUE(store_->addPerson("later", {"later@x.example"}, kNow));
    ASSERT_TRUE(store_->revokeGrant(ann_, otto_));
    store_->present(kNow + 900);
    ASSERT_TRUE(keep({}));
    ASSERT_EQ(restore(file()), "");
    EXPECT_EQ(filesBeside(), std::vector<std::string>{"backup"});
    EXPECT_EQ(names(), (std::vector<std::string>{"ann", "mara", "otto"})) << "the backup and nothing else";
    EXPECT_EQ(store_->personOf("ann@x.example"), ann_);
    const auto sharing = store_->sharing(otto_, ann_);
    ASSERT_TRUE(sharing && sharing->grant);
    EXPECT_TRUE(sharing->hidden);
    EXPECT_EQ(sharing->latest, kNow + 900) << "the latest time that either has seen";
    for (const char* name : {"fix", "viewed", "sign_in", "browser"}) {
        EXPECT_EQ(count(std::string("SELECT count(*) FROM ") + name), 0) << name;
    }
    bool failed = false;
    EXPECT_TRUE(store_->deviceOf("ann's", failed)) << "a phone sends as before";
    EXPECT_EQ(store_->deviceOf("otto's", failed), std::nullopt) << "a reader waits";
    EXPECT_EQ(store_->confirm(mara_), 0);
    EXPECT_EQ(store_->deviceOf("otto's", failed), std::nullopt) << "for its own person";
    EXPECT_EQ(store_->confirm(otto_), 1);
    EXPECT_TRUE(store_->deviceOf("otto's", failed));
    EXPECT_TRUE(store_->person(ann_)->hidden) << "that shows nobody";
    EXPECT_TRUE(store_->person(otto_)->hidden);
    EXPECT_EQ(store_->check(), "");
}

TEST_P(StoreKeeping, Backup_OfOneDatabase_IsRestoredIntoTheOther) {
    fill(*store_, ann_, otto_, phone_);
    ASSERT_EQ(store_->backup(file()), "");
    std::string complaint;
    const std::string folder = file("elsewhere");
    const auto other = Store::open({folder}, true, complaint);
    ASSERT_TRUE(other) << complaint;
    ASSERT_EQ(other->restore(file(), folder, kNow), "");
    EXPECT_EQ(other->personOf("ann@x.example"), ann_);
    ASSERT_EQ(other->backup(file("back")), "");
    ASSERT_EQ(restore(file("back")), "");
    EXPECT_EQ(names(), (std::vector<std::string>{"ann", "mara", "otto"}));
    bool failed = false;
    EXPECT_EQ(store_->deviceOf("ann's", failed)->person, ann_);
}

TEST_P(StoreKeeping, WhatIsNoBackup_IsRefused_AndChangesNothing) {
    folder_.write("text", std::string(5000, 'x'));
    folder_.write("empty", "");
    ASSERT_EQ(::mkdir(file("folder").c_str(), 0700), 0);
    ASSERT_EQ(::mkfifo(file("pipe").c_str(), 0600), 0);
    ASSERT_EQ(store_->backup(file("newer")), "");
    ASSERT_EQ(store_->backup(file("damaged")), "");
    sqlite3* handle = nullptr;
    ASSERT_EQ(sqlite3_open(file("newer").c_str(), &handle), SQLITE_OK);
    sqlite3_exec(handle, "PRAGMA user_version = 1000", nullptr, nullptr, nullptr);
    sqlite3_close(handle);
    ASSERT_EQ(sqlite3_open(file("damaged").c_str(), &handle), SQLITE_OK);
    sqlite3_exec(handle, "PRAGMA foreign_keys = OFF; DELETE FROM person", nullptr, nullptr, nullptr);
    sqlite3_close(handle);
    const std::vector<std::string> before = filesBeside();
    for (const char* name : {"text", "empty", "folder", "pipe", "newer", "damaged", "missing"}) {
        const std::string complaint = restore(file(name));
        EXPECT_EQ(complaint.rfind(file(name) + ": ", 0), 0U) << complaint;
    }
    EXPECT_EQ(restore(file("newer")), file("newer") + ": was written by a newer program: use that one");
    EXPECT_EQ(filesBeside(), before);
    EXPECT_EQ(names(), (std::vector<std::string>{"ann", "mara", "otto"}));
    EXPECT_FALSE(store_->person(ann_)->hidden);
}

TEST_P(StoreKeeping, SomebodyForgotten_IsNowhere_AndNoBackupBringsThemBack) {
    fill(*store_, ann_, otto_, phone_);
    ASSERT_EQ(store_->backup(file()), "");
    ASSERT_TRUE(store_->forget(ann_, kNow));
    EXPECT_FALSE(store_->forget(ann_, kNow)) << "nobody is forgotten twice";
    for (const StoreTable& table : StoreTables::all()) {
        for (const std::string_view column : table.people) {
            if (!column.empty()) {
                EXPECT_EQ(count("SELECT count(*) FROM " + std::string(table.name) + " WHERE " + std::string(column) +
                                " = " + std::to_string(ann_)),
                          0)
                    << table.name;
            }
        }
    }
    // Somebody else of that name is somebody else.
    ASSERT_TRUE(store_->addPerson("ann", {"ann@x.example"}, kNow));
    const auto second = store_->personNamed("ann")->id;
    EXPECT_NE(second, ann_);
    ASSERT_EQ(store_->backup(file("second")), "");
    ASSERT_EQ(restore(file()), "");
    EXPECT_EQ(names(), (std::vector<std::string>{"mara", "otto"}));
    ASSERT_EQ(restore(file("second")), "");
    EXPECT_EQ(store_->personNamed("ann")->id, second);
    ASSERT_EQ(restore(file()), "");
    EXPECT_EQ(names(), (std::vector<std::string>{"mara", "otto"})) << "what a restore replaced stays forgotten";
}

TEST_P(StoreKeeping, Export_IsAllOfOnePerson_WithoutSecretsAndNumbersOfOthers) {
    fill(*store_, ann_, otto_, phone_);
    ASSERT_TRUE(store_->grant(mara_, ann_, {Precision::Town, kNow, kNow + 60}));
    const auto everything = store_->everythingOf(ann_);
    ASSERT_TRUE(everything);
    const std::string text = platform::writeJson(*everything);
    const auto has = [&](const std::string& part) { return text.find(part) != std::string::npos; };
    EXPECT_TRUE(has("12.34567891")) << text;
    EXPECT_TRUE(has("\"shown\":\"ann@x.example\"")) << text;
    EXPECT_TRUE(has("\"owner\":\"mara\",\"exactness\":2")) << text;
    EXPECT_TRUE(has("\"viewer\":\"otto\"")) << text;
    for (const StoreTable& table : StoreTables::all()) {
        EXPECT_EQ(everything->contains(table.name), !table.people[0].empty()) << table.name;
        for (const std::string_view secret : table.secrets) {
            EXPECT_FALSE(!secret.empty() && has("\"" + std::string(secret) + "\":")) << secret;
        }
    }
    for (const std::int64_t id : {ann_, otto_, mara_}) {
        EXPECT_FALSE(has(std::to_string(id))) << text;
    }
    const auto others = store_->everythingOf(mara_);
    ASSERT_TRUE(others);
    EXPECT_EQ(platform::writeJson(*others).find("12.3456"), std::string::npos) << "nobody else's places";
}

TEST_P(StoreKeeping, Retention_IsThePersons_AndHoldsAtOnce) {
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, 0, std::nullopt}));
    EXPECT_EQ(store_->retention(ann_), Retention());
    ASSERT_TRUE(keep({at(kNow - 90000), at(kNow - 3000), at(kNow - 10)}));
    for (const std::int64_t ago : {0, 20, 200}) {
        ASSERT_TRUE(finished([&](auto done) { store_->noteLooks(otto_, {ann_}, true, kNow - ago * 3600, done); }));
    }
    ASSERT_TRUE(store_->setRetention(ann_, {3600, 86400}, kNow));
    EXPECT_EQ(store_->retention(ann_), (Retention{3600, 86400}));
    EXPECT_EQ(store_->retention(otto_), Retention());
    EXPECT_EQ(seenByOtto(), (std::vector<Fix>{at(kNow - 3000), at(kNow - 10)}));
    EXPECT_EQ(count("SELECT count(*) FROM viewed"), 2);
    bool failed = false;
    EXPECT_EQ(store_->deviceOf("ann's", failed)->retention, 3600);
    for (int i = 0; i < 2; ++i) {
        EXPECT_TRUE(finished([&](auto done) { store_->deleteOld(kNow + 1000, done); }));
    }
    EXPECT_EQ(seenByOtto(), std::vector<Fix>{at(kNow - 10)});
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreKeeping, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreKeeping, ::testing::Values(true));

/// What is forgotten is not in the file's bytes either.
class StoreErasure : public StoreContract {
  protected:
    /// In the file and in the log before it.
    bool hasBytes(const std::string& bytes) const {
        bool found = false;
        for (const char* name : {"service.db", "service.db-wal"}) {
            const std::string all = TemporaryFolder::read(address_.text + "/" + name);
            found = found || all.find(bytes) != std::string::npos;
        }
        return found;
    }
    /// A number as the file has it.
    static std::string bytesOf(double number) {
        std::string bytes(reinterpret_cast<const char*>(&number), sizeof number);
        return {bytes.rbegin(), bytes.rend()};
    }
};

TEST_P(StoreErasure, WhatIsForgotten_IsNotInTheFilesBytes) {
    const double latitude = 12.345678912345;
    const double later = 23.456789123456;
    ASSERT_TRUE(store_->addPerson("Wilhelmina", {"wilhelmina@x.example"}, kNow));
    const auto person = store_->personNamed("Wilhelmina")->id;
    for (int i = 0; i < 300; ++i) {
        const Fix fix = at(kNow - i, i % 2 == 0 ? latitude : later);
        ASSERT_TRUE(finished([&](auto done) { store_->keep(phone_, person, {fix}, kNow, done); }));
        ASSERT_TRUE(keep({at(kNow - i, 45.678912345678)}));
    }
    ASSERT_TRUE(hasBytes("wilhelmina@x.example") && hasBytes(bytesOf(latitude)) && hasBytes(bytesOf(later)));
    ASSERT_TRUE(store_->forget(person, kNow));
    EXPECT_FALSE(hasBytes("ilhelmina"));
    EXPECT_FALSE(hasBytes(bytesOf(latitude)));
    EXPECT_FALSE(hasBytes(bytesOf(later)));
    EXPECT_TRUE(hasBytes(bytesOf(45.678912345678))) << "somebody else's stays";
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreErasure, ::testing::Values(false));

}  // namespace ktr::test
