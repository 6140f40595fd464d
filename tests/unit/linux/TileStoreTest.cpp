#include "linux/maps/TileStore.h"

#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>

#include "linux/maps/TileFreshness.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::linux_ {

class TileStoreTest : public ::testing::Test {
  protected:
    static TileStore::Entry entry(std::size_t size = 10, std::uint8_t byte = 7) {
        return {platform::Bytes(size, byte), 1800000000, "\"abc\"", "Sun, 06 Nov 1994 08:49:37 GMT"};
    }
    std::uint64_t bytes() const {
        std::uint64_t total = 0;
        for (const auto& file : std::filesystem::recursive_directory_iterator(folder.path())) {
            total += file.is_regular_file() ? file.file_size() : 0;
        }
        return total;
    }
    std::filesystem::path only() const {
        for (const auto& file : std::filesystem::recursive_directory_iterator(folder.path())) {
            if (file.is_regular_file()) {
                return file.path();
            }
        }
        return {};
    }

    test::TemporaryFolder folder;
    TileStore store{folder.path() / "tiles", "https://tiles.example/{z}/{x}/{y}.png", 1 << 20};
};

TEST_F(TileStoreTest, WhatIsSaved_IsLoaded) {
    EXPECT_FALSE(store.load({1, 0, 1}).has_value());
    store.save({1, 0, 1}, entry());
    const auto loaded = store.load({1, 0, 1});
    ASSERT_TRUE(loaded.has_value());
    EXPECT_EQ(loaded->data, entry().data);
    EXPECT_EQ(loaded->expires, 1800000000);
    EXPECT_EQ(loaded->etag, "\"abc\"");
    EXPECT_EQ(loaded->modified, "Sun, 06 Nov 1994 08:49:37 GMT");
    EXPECT_FALSE(store.load({1, 1, 1}).has_value());
}

TEST_F(TileStoreTest, AnotherAddress_HasAStoreOfItsOwn) {
    store.save({1, 0, 1}, entry());
    TileStore other(folder.path() / "tiles", "https://other.example/{z}/{x}/{y}.png", 1 << 20);
    EXPECT_FALSE(other.load({1, 0, 1}).has_value());
    TileStore again(folder.path() / "tiles", "https://tiles.example/{z}/{x}/{y}.png", 1 << 20);
    EXPECT_TRUE(again.load({1, 0, 1}).has_value());
}

TEST_F(TileStoreTest, FilesAreForNobodyElse) {
    store.save({1, 0, 1}, entry());
    const auto permissions = std::filesystem::status(folder.path() / "tiles").permissions();
    EXPECT_EQ(permissions & (std::filesystem::perms::group_all | std::filesystem::perms::others_all),
              std::filesystem::perms::none);
}

TEST_F(TileStoreTest, DamagedFiles_AreNoTiles) {
    store.save({1, 0, 1}, entry());
    const auto file = only();
    const std::string good = test::TemporaryFolder::read(file);
    for (const std::string& bad :
         {good.substr(0, good.size() - 1), good + "x", std::string(), std::string("ktr-tile 2\n"),
          "ktr-tile 1\nsoon" + good.substr(21), std::string(5000, '\n')}) {
        folder.write(std::filesystem::relative(file, folder.path()).string(), bad);
        EXPECT_FALSE(store.load({1, 0, 1}).has_value()) << bad.substr(0, 20);
    }
    folder.write(std::filesystem::relative(file, folder.path()).string(), good);
    EXPECT_TRUE(store.load({1, 0, 1}).has_value());
}

TEST_F(TileStoreTest, FieldsThatBreakLines_AreLeftOut) {
    auto bad = entry();
    bad.etag = "a\nb";
    store.save({1, 0, 1}, bad);
    const auto loaded = store.load({1, 0, 1});
    ASSERT_TRUE(loaded.has_value());
    EXPECT_EQ(loaded->etag, "");
}

TEST_F(TileStoreTest, BeyondTheCap_TheOldestGo) {
    for (int x = 0; x < 30; ++x) {
        store.save({6, x, 0}, entry(60000));
        // As if it had been used an hour before the next one.
        for (const auto& file : std::filesystem::recursive_directory_iterator(folder.path())) {
            if (file.is_regular_file()) {
                std::filesystem::last_write_time(file, file.last_write_time() - std::chrono::hours(1));
            }
        }
    }
    EXPECT_LE(bytes(), 1100000U);
    EXPECT_GE(bytes(), 700000U);
    EXPECT_FALSE(store.load({6, 0, 0}).has_value());
    EXPECT_TRUE(store.load({6, 29, 0}).has_value());
}

TEST_F(TileStoreTest, TooLargeAndEmptyTiles_AreNotKept) {
    store.save({1, 0, 0}, entry(TileStore::kLargestTile + 1));
    store.save({1, 0, 1}, entry(0));
    EXPECT_FALSE(store.load({1, 0, 0}).has_value());
    EXPECT_FALSE(store.load({1, 0, 1}).has_value());
}

TEST_F(TileStoreTest, AFolderThatCannotBeWritten_LosesTheTileOnly) {
    TileStore lost("/proc/nowhere", "a", 1000);
    lost.save({1, 0, 0}, entry());
    EXPECT_FALSE(lost.load({1, 0, 0}).has_value());
}

TEST(TileFreshnessTest, FollowsTheServersWord) {
    constexpr std::int64_t kNow = 784111777;  // Sun, 06 Nov 1994 08:49:37 GMT
    const auto expires = [](const char* control, const char* age = "", const char* date = "") {
        return TileFreshness::of(control, age, date, kNow).expires - kNow;
    };
    EXPECT_EQ(expires("max-age=600"), 600);
    EXPECT_EQ(expires("public, Max-Age=600"), 600);
    EXPECT_EQ(expires("max-age=600", "100"), 500);
    EXPECT_EQ(expires("max-age=600", "900"), 0);
    EXPECT_EQ(expires("max-age=soon"), 0);
    EXPECT_EQ(expires("no-cache, max-age=600"), 0);
    EXPECT_EQ(expires("max-age=999999999999"), 365 * 86400);
    EXPECT_EQ(expires("", "", "Sun, 06 Nov 1994 08:50:37 GMT"), 60);
    EXPECT_EQ(expires("max-age=5", "", "Sun, 06 Nov 1994 08:50:37 GMT"), 5);
    EXPECT_EQ(expires("", "", "0"), 0);
    EXPECT_EQ(expires(""), 86400);
    EXPECT_TRUE(TileFreshness::of("max-age=1", "", "", kNow).isStored);
    EXPECT_FALSE(TileFreshness::of("no-store", "", "", kNow).isStored);
}

}  // namespace ktr::linux_
