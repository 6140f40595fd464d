#include "tiles/MbtilesIndex.h"

#include <sqlite3.h>

#include <cstring>
#include <filesystem>
#include <memory>
#include <string_view>
#include <system_error>

#include "documents/FileSteps.h"

namespace ktr::tiles {

namespace {

constexpr unsigned kOwnersAlone = 0600;

struct Close {
    void operator()(sqlite3* database) const { sqlite3_close_v2(database); }
    void operator()(sqlite3_stmt* statement) const { sqlite3_finalize(statement); }
};
using Database = std::unique_ptr<sqlite3, Close>;

/// Nothing that the file defines runs.
Database open(const std::string& path, int flags) {
    sqlite3* opened = nullptr;
    const std::string plain = path.starts_with('/') ? path : "./" + path;
    if (sqlite3_open_v2(plain.c_str(), &opened, flags, nullptr) != SQLITE_OK) {
        sqlite3_close_v2(opened);
        return nullptr;
    }
    sqlite3_db_config(opened, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
    sqlite3_db_config(opened, SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
    sqlite3_db_config(opened, SQLITE_DBCONFIG_ENABLE_TRIGGER, 0, nullptr);
    return Database(opened);
}

}  // namespace

MbtilesIndex::State MbtilesIndex::stateOf(const std::string& path) {
    const Database database = open(path, SQLITE_OPEN_READONLY);
    sqlite3_stmt* raw = nullptr;
    if (!database ||
        sqlite3_prepare_v2(database.get(),
                           "EXPLAIN QUERY PLAN SELECT tile_data FROM tiles WHERE zoom_level=?1 AND tile_column=?2 AND "
                           "tile_row=?3",
                           -1, &raw, nullptr) != SQLITE_OK) {
        return State::Unreadable;
    }
    const std::unique_ptr<sqlite3_stmt, Close> plan(raw);
    constexpr int kDetail = 3;
    while (sqlite3_step(plan.get()) == SQLITE_ROW) {
        const auto* detail = reinterpret_cast<const char*>(sqlite3_column_text(plan.get(), kDetail));
        if (detail != nullptr && std::string_view(detail).starts_with("SCAN")) {
            return State::Unindexed;
        }
    }
    return State::Indexed;
}

std::string MbtilesIndex::copyIndexed(const std::string& from, const std::string& to) {
    // Whatever the file allows, its copy is to be written to.
    if (const int failure = documents::FileSteps::copyNew(from, to, kOwnersAlone); failure != 0) {
        return std::strerror(failure);
    }
    std::string problem;
    {
        const Database database = open(to, SQLITE_OPEN_READWRITE);
        if (!database ||
            sqlite3_exec(database.get(), "CREATE INDEX ktr_tile_index ON tiles (zoom_level, tile_column, tile_row)",
                         nullptr, nullptr, nullptr) != SQLITE_OK) {
            problem = database ? sqlite3_errmsg(database.get()) : "it cannot be opened";
        }
    }
    if (!problem.empty()) {
        std::error_code nothingLeftToDo;
        std::filesystem::remove(to, nothingLeftToDo);
    }
    return problem;
}

}  // namespace ktr::tiles
