#pragma once

#include <sqlite3.h>

#include <gtest/gtest.h>

#include <string>

#include "tiles/TileKey.h"

namespace ktr::test {

/// Writes an MBTiles file for a test.
class MbtilesWriter {
  public:
    explicit MbtilesWriter(const std::string& path) {
        sqlite3_open(path.c_str(), &database_);
        run("PRAGMA synchronous=OFF");
    }
    ~MbtilesWriter() { sqlite3_close(database_); }
    MbtilesWriter(const MbtilesWriter&) = delete;
    MbtilesWriter& operator=(const MbtilesWriter&) = delete;

    void run(const std::string& command) {
        char* error = nullptr;
        EXPECT_EQ(sqlite3_exec(database_, command.c_str(), nullptr, nullptr, &error), SQLITE_OK)
            << command << ": " << (error ? error : "");
        sqlite3_free(error);
    }
    void makeTables() {
        run("CREATE TABLE metadata (name TEXT, value TEXT);"
            "CREATE TABLE tiles (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER, tile_data BLOB);"
            "CREATE UNIQUE INDEX tile_index ON tiles (zoom_level, tile_column, tile_row)");
    }
    void putMetadata(const std::string& name, const std::string& value) {
        put("INSERT INTO metadata VALUES (?1, ?2)", [&](sqlite3_stmt* statement) {
            sqlite3_bind_text(statement, 1, name.data(), static_cast<int>(name.size()), SQLITE_TRANSIENT);
            sqlite3_bind_text(statement, 2, value.data(), static_cast<int>(value.size()), SQLITE_TRANSIENT);
        });
    }
    /// Rows are stored from the south.
    void putTile(const tiles::TileKey& key, const std::string& data) {
        put("INSERT INTO tiles VALUES (?1, ?2, ?3, ?4)", [&](sqlite3_stmt* statement) {
            sqlite3_bind_int(statement, 1, key.z);
            sqlite3_bind_int(statement, 2, key.x);
            sqlite3_bind_int(statement, 3, (1 << key.z) - 1 - key.y);
            sqlite3_bind_blob(statement, 4, data.data(), static_cast<int>(data.size()), SQLITE_TRANSIENT);
        });
    }

  private:
    template <class Bind>
    void put(const char* command, const Bind& bind) {
        sqlite3_stmt* statement = nullptr;
        ASSERT_EQ(sqlite3_prepare_v2(database_, command, -1, &statement, nullptr), SQLITE_OK)
            << sqlite3_errmsg(database_);
        bind(statement);
        EXPECT_EQ(sqlite3_step(statement), SQLITE_DONE) << sqlite3_errmsg(database_);
        sqlite3_finalize(statement);
    }

    sqlite3* database_ = nullptr;
};

}  // namespace ktr::test
