#include "server/store/StoreCopy.h"

#include <fcntl.h>
#include <stdlib.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <filesystem>
#include <set>
#include <vector>

#include "documents/FileSteps.h"
#include "documents/StagedFiles.h"
#include "server/store/Migrations.h"
#include "server/store/Records.h"
#include "server/store/Secret.h"
#include "server/store/SqliteDatabase.h"
#include "server/store/StoreTables.h"

namespace ktr::server {

using documents::FileSteps;

namespace {

/// A new folder for this user alone; empty, with the reason in `errno`, when it cannot be made.
std::string makePrivateFolder(const std::string& beside) {
    std::string name = beside + ".XXXXXX";
    return ::mkdtemp(name.data()) == nullptr ? std::string() : name;
}

void removeFolder(const std::string& folder) {
    std::error_code ignored;
    if (!folder.empty()) {
        std::filesystem::remove_all(folder, ignored);
    }
}

/// "a, b, c" and "$1, $2, $3".
struct ColumnList {
    std::string names;
    std::string places;
};

ColumnList columnsOf(Database& database, std::string_view table) {
    const std::string sql = "SELECT * FROM " + std::string(table) + " LIMIT 0";
    auto row = database.statement(sql.c_str());
    row.next();
    ColumnList list;
    for (int i = 0; !database.failed() && i < row.columns(); ++i) {
        list.names += (i == 0 ? "" : ", ") + row.nameOf(i);
        list.places += (i == 0 ? "$" : ", $") + std::to_string(i + 1);
    }
    return list;
}

/// All rows of the tables that a backup has. False: one of the two databases says why.
bool copyTables(Database& from, Database& to) {
    for (const StoreTable& table : StoreTables::all()) {
        if (!table.inBackup) {
            continue;
        }
        const ColumnList columns = columnsOf(to, table.name);
        const std::string name(table.name);
        const std::string reading = "SELECT " + columns.names + " FROM " + name;
        const std::string writing = "INSERT INTO " + name + " (" + columns.names + ") VALUES (" + columns.places + ")";
        auto row = from.statement(reading.c_str());
        while (!to.failed() && row.next()) {
            auto copy = to.statement(writing.c_str());
            for (int i = 0; i < row.columns(); ++i) {
                copy.bind(row.value(i));
            }
            copy.run();
        }
    }
    return !from.failed() && to.settle();
}

void deleteAll(Database& database) {
    const auto tables = StoreTables::all();
    for (auto table = tables.rbegin(); table != tables.rend(); ++table) {
        database.execute("DELETE FROM " + std::string(table->name));
    }
}

/// Empty when the new file has it all.
std::string fill(Database& from, const std::string& file) {
    std::string complaint;
    const auto copy = SqliteDatabase::open(file, complaint);
    if (!copy) {
        return complaint;
    }
    if (complaint = Migrations::run(*copy, true); !complaint.empty()) {
        return complaint;
    }
    const bool isWhole = from.beginReading() && copy->begin() && copy->execute("DELETE FROM clock") &&
                         copyTables(from, *copy) && copy->commit() &&
                         // One file, without others beside it.
                         copy->execute("PRAGMA journal_mode = DELETE");
    complaint = isWhole ? "" : from.failed() ? from.complaint() : copy->complaint();
    from.rollback();
    return complaint;
}

/// 0 or the errno of the failure.
int bringToDisk(const std::string& file) {
    const int descriptor = ::open(file.c_str(), O_RDONLY | O_CLOEXEC);
    const int failure = descriptor < 0 || ::fsync(descriptor) != 0 ? errno : 0;
    if (descriptor >= 0) {
        ::close(descriptor);
    }
    return failure;
}

/// Empty when `to` has the bytes of the file `from`.
std::string copyFile(const std::string& from, const std::string& to) {
    struct stat facts {};
    // Without waiting for a pipe's other end.
    const int descriptor = ::open(from.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    const int failure = descriptor < 0 || ::fstat(descriptor, &facts) != 0 ? errno : 0;
    if (descriptor >= 0) {
        ::close(descriptor);
    }
    if (failure != 0) {
        return FileSteps::sentence(from, "read", failure);
    }
    if (!S_ISREG(facts.st_mode)) {
        return from + ": is not a file";
    }
    std::error_code error;
    std::filesystem::copy_file(from, to, error);
    return error ? FileSteps::sentence(from, "copied", error.value()) : "";
}

std::set<std::string> forgottenIn(Database& database) {
    std::set<std::string> hashes;
    auto row = database.statement("SELECT hash FROM forgotten");
    while (row.next()) {
        hashes.insert(row.text(0));
    }
    return hashes;
}

void forgetAgain(Database& database, const std::set<std::string>& before, std::int64_t now) {
    for (const std::string& hash : before) {
        database.statement("INSERT INTO forgotten (hash, made) VALUES ($1, $2) ON CONFLICT DO NOTHING")
            .bindBytes(hash)
            .bind(now)
            .run();
    }
    const std::set<std::string> all = forgottenIn(database);
    std::vector<std::int64_t> back;
    {
        auto row = database.statement("SELECT id, identity FROM person");
        while (row.next()) {
            if (all.count(Secret::hash(row.text(1))) != 0) {
                back.push_back(row.integer(0));
            }
        }
    }
    for (const std::int64_t person : back) {
        database.statement("DELETE FROM person WHERE id = $1").bind(person).run();
    }
}

}  // namespace

std::string StoreCopy::write(Database& database, const std::string& file) {
    if (auto problem = documents::StagedFiles::refusal(file); !problem.empty()) {
        return problem;
    }
    const std::string folder = makePrivateFolder(file);
    if (folder.empty()) {
        return FileSteps::sentence(file, "written", errno);
    }
    const std::string copy = folder + "/copy";
    std::string complaint = fill(database, copy);
    if (!complaint.empty()) {
        complaint = file + ": cannot be written: " + complaint;
    } else if (const int failure = bringToDisk(copy); failure != 0) {
        complaint = FileSteps::sentence(file, "brought to the disk", failure);
    } else if (::rename(copy.c_str(), file.c_str()) != 0) {
        complaint = FileSteps::sentence(file, "replaced", errno);
    } else if (const int unsure = FileSteps::syncFolder(FileSteps::folderOf(file)); unsure != 0) {
        complaint = FileSteps::sentence(file, "brought to the disk", unsure);
    }
    removeFolder(folder);
    return complaint;
}

StoreCopy::Opened::Opened(const std::string& file, const std::string& folder)
    : folder_(makePrivateFolder(folder + "/restoring")) {
    if (folder_.empty()) {
        complaint_ = FileSteps::sentence(folder, "written", errno);
        return;
    }
    const std::string copy = folder_ + "/copy";
    if (complaint_ = copyFile(file, copy); !complaint_.empty()) {
        return;
    }
    std::string problem;
    database_ = SqliteDatabase::open(copy, problem);
    if (database_) {
        problem = Migrations::run(*database_, false);
    }
    if (problem.empty()) {
        problem = database_->check();
    }
    complaint_ = problem.empty() ? "" : file + ": " + problem;
}

StoreCopy::Opened::~Opened() {
    database_.reset();
    removeFolder(folder_);
}

void StoreCopy::restore(Database& database, Database& backup, std::int64_t now) {
    const std::set<std::string> forgotten = forgottenIn(database);
    std::int64_t latest = 0;
    if (auto row = database.statement("SELECT latest FROM clock"); row.next()) {
        latest = row.integer(0);
    }
    deleteAll(database);
    if (!copyTables(backup, database)) {
        database.note(backup.complaint());
        return;
    }
    forgetAgain(database, forgotten, now);
    database.statement("UPDATE device SET suspended = 1 WHERE kind = $1")
        .bind(static_cast<std::int64_t>(DeviceKind::Reader))
        .run();
    database.statement("UPDATE clock SET latest = $1 WHERE latest < $1").bind(latest).run();
}

}  // namespace ktr::server
