#include "tiles/MbtilesIndex.h"

#include <sqlite3.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <fstream>

#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

namespace ktr::tiles {

namespace {

class MbtilesIndexTest : public ::testing::Test {
  protected:
    std::string make(const std::string& name, const std::string& statements) {
        std::string path = (folder.path() / name).string();
        sqlite3* database = nullptr;
        EXPECT_EQ(sqlite3_open(path.c_str(), &database), SQLITE_OK);
        EXPECT_EQ(sqlite3_exec(database, statements.c_str(), nullptr, nullptr, nullptr), SQLITE_OK);
        sqlite3_close(database);
        return path;
    }

    const std::string tiles_ =
        "CREATE TABLE tiles (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER, tile_data BLOB);"
        "INSERT INTO tiles VALUES (3, 1, 2, x'00');";
    ktr::test::TemporaryFolder folder;
};

TEST_F(MbtilesIndexTest, AFileWithoutAnIndexGetsACopyWithOne_AndStaysAsItIs) {
    const auto plain = make("plain.mbtiles", tiles_);
    EXPECT_EQ(MbtilesIndex::stateOf(plain), MbtilesIndex::State::Unindexed);
    const auto copy = (folder.path() / "copy.mbtiles").string();
    EXPECT_EQ(MbtilesIndex::copyIndexed(plain, copy), "");
    EXPECT_EQ(MbtilesIndex::stateOf(copy), MbtilesIndex::State::Indexed);
    EXPECT_EQ(MbtilesIndex::stateOf(plain), MbtilesIndex::State::Unindexed);
    EXPECT_NE(MbtilesIndex::copyIndexed(plain, copy), "") << "what is there is not overwritten";
}

// A map of two gigabytes that does not fit must not leave the disk full; and a map that may not be written to is copied
// all the same.
TEST_F(MbtilesIndexTest, ACopyThatDoesNotFit_IsTakenAwayAndTheReasonSaid) {
    const auto plain = make("plain.mbtiles", tiles_);
    std::filesystem::permissions(plain, std::filesystem::perms::owner_read);
    const auto copy = (folder.path() / "copy.mbtiles").string();
    const pid_t child = ::fork();
    if (child == 0) {
        std::signal(SIGXFSZ, SIG_IGN);
        const rlimit few{3000, 3000};
        ::setrlimit(RLIMIT_FSIZE, &few);
        ::_exit(MbtilesIndex::copyIndexed(plain, copy) == "File too large" ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    EXPECT_FALSE(std::filesystem::exists(copy));
    EXPECT_EQ(MbtilesIndex::copyIndexed(plain, copy), "");
    EXPECT_EQ(std::filesystem::status(copy).permissions(),
              std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
}

TEST_F(MbtilesIndexTest, AnIndexIsSeen_AlsoBehindAView) {
    EXPECT_EQ(MbtilesIndex::stateOf(make(
                  "indexed.mbtiles", tiles_ + "CREATE UNIQUE INDEX i ON tiles (zoom_level, tile_column, tile_row);")),
              MbtilesIndex::State::Indexed);
    EXPECT_EQ(MbtilesIndex::stateOf(make(
                  "view.mbtiles",
                  "CREATE TABLE map (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER, tile_id TEXT);"
                  "CREATE TABLE images (tile_id TEXT, tile_data BLOB);"
                  "CREATE UNIQUE INDEX m ON map (zoom_level, tile_column, tile_row);"
                  "CREATE UNIQUE INDEX n ON images (tile_id);"
                  "CREATE VIEW tiles AS SELECT zoom_level, tile_column, tile_row, tile_data FROM map JOIN images ON "
                  "images.tile_id = map.tile_id;")),
              MbtilesIndex::State::Indexed);
}

TEST_F(MbtilesIndexTest, WhatIsNoMapCannotBeRead_AndLeavesNoCopy) {
    const auto text = (folder.path() / "text.mbtiles").string();
    std::ofstream(text) << "no database at all, only words, and some more of them";
    EXPECT_EQ(MbtilesIndex::stateOf(text), MbtilesIndex::State::Unreadable);
    EXPECT_EQ(MbtilesIndex::stateOf((folder.path() / "missing").string()), MbtilesIndex::State::Unreadable);
    const auto copy = (folder.path() / "copy.mbtiles").string();
    EXPECT_NE(MbtilesIndex::copyIndexed(text, copy), "");
    EXPECT_FALSE(std::filesystem::exists(copy));
    const auto view = make("view.mbtiles",
                           "CREATE VIEW tiles AS SELECT 1 AS zoom_level, 2 AS tile_column, 3 AS "
                           "tile_row, x'00' AS tile_data;");
    EXPECT_NE(MbtilesIndex::copyIndexed(view, copy), "");
    EXPECT_FALSE(std::filesystem::exists(copy));
}

}  // namespace

}  // namespace ktr::tiles
