#include "linux/maps/MbtilesLoader.h"

#include <QDir>
#include <QFile>
#include <QTemporaryDir>
#include <chrono>
#include <filesystem>

#include <sys/stat.h>

#include "tests/support/PlatformTest.h"
#include "tests/support/maps/MbtilesWriter.h"

namespace ktr::linux_ {

class MbtilesLoaderTest : public test::PlatformTest {
  protected:
    std::string path(const QString& name = QStringLiteral("town.mbtiles")) const {
        return folder.filePath(name).toStdString();
    }
    std::shared_ptr<tiles::MbtilesFile> open() { return MbtilesLoader::open(path(), error); }
    QByteArray content() const {
        QFile file(QString::fromStdString(path()));
        EXPECT_TRUE(file.open(QIODevice::ReadOnly));
        return file.readAll();
    }
    void write(const QByteArray& data) const {
        QFile file(QString::fromStdString(path()));
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(data);
    }
    void makeTown() const {
        test::MbtilesWriter writer(path());
        writer.makeTables();
        writer.putMetadata("format", "pbf");
        writer.putMetadata("name", "Town");
        writer.putTile({14, 8800, 5373}, "north-western");
        writer.putTile({3, 4, 2}, "coarse");
    }
    static std::string text(const std::optional<platform::Bytes>& bytes) {
        return bytes ? std::string(bytes->begin(), bytes->end()) : std::string("none");
    }

    QTemporaryDir folder;
    std::string error;
};

TEST_F(MbtilesLoaderTest, Tile_IsFoundFromTheNorth) {
    makeTown();
    const auto file = open();
    ASSERT_NE(file, nullptr) << error;
    EXPECT_EQ(text(file->tile({14, 8800, 5373})), "north-western");
    EXPECT_EQ(text(file->tile({3, 4, 2})), "coarse");
    EXPECT_EQ(text(file->tile({3, 4, 5})), "none");
    EXPECT_EQ(text(file->tile({99, 4, 5})), "none");
    EXPECT_EQ(text(file->tile({-1, 4, 5})), "none");
    EXPECT_EQ(file->metadata().at("name"), "Town");
    EXPECT_EQ(file->coarsestLevel(), 3);
    EXPECT_EQ(file->finestLevel(), 14);
}

TEST_F(MbtilesLoaderTest, Reading_WritesNothing) {
    makeTown();
    const auto before = content();
    {
        const auto file = open();
        ASSERT_NE(file, nullptr);
        file->tile({3, 4, 2});
    }
    EXPECT_EQ(content(), before);
    EXPECT_EQ(QDir(folder.path()).entryList(QDir::Files).size(), 1);
}

TEST_F(MbtilesLoaderTest, NoFile_OrNoDatabase_IsAnError) {
    EXPECT_EQ(open(), nullptr);
    EXPECT_FALSE(error.empty());
    EXPECT_FALSE(QFile::exists(QString::fromStdString(path())));
    error.clear();
    EXPECT_EQ(MbtilesLoader::open(folder.path().toStdString(), error), nullptr);
    EXPECT_FALSE(error.empty());
    for (const QByteArray& data : {QByteArray(), QByteArray("PK\3\4 no database"), QByteArray(100000, 'x')}) {
        write(data);
        error.clear();
        EXPECT_EQ(open(), nullptr);
        EXPECT_FALSE(error.empty());
    }
}

// Opening a pipe waits for somebody who writes into it.
TEST_F(MbtilesLoaderTest, PipeBesideTheFile_IsAnErrorNow) {
    makeTown();
    const std::string link = folder.filePath(QStringLiteral("link")).toStdString();
    std::filesystem::create_symlink(path(), link);
    for (const char* end : {"-journal", "-wal", "-shm"}) {
        const std::string beside = path() + end;
        ASSERT_EQ(::mkfifo(beside.c_str(), 0600), 0);
        EXPECT_EQ(open(), nullptr);
        EXPECT_TRUE(error.starts_with("not a file")) << error;
        EXPECT_EQ(MbtilesLoader::open(link, error), nullptr);
        std::filesystem::remove(beside);
        EXPECT_NE(open(), nullptr);
    }
}

TEST_F(MbtilesLoaderTest, CutFile_GivesAnErrorOrNoTiles) {
    {
        test::MbtilesWriter writer(path());
        writer.makeTables();
        for (int x = 0; x < 64; ++x) {
            writer.putTile({8, x, 17}, std::string(3000, static_cast<char>('a' + x % 26)));
        }
    }
    const auto whole = content();
    for (const qsizetype size :
         {qsizetype{50}, qsizetype{100}, qsizetype{4096}, qsizetype{4097}, whole.size() / 2, whole.size() - 1}) {
        write(whole.left(size));
        const auto file = open();
        if (!file) {
            continue;
        }
        for (int x = 0; x < 64; ++x) {
            const auto tile = file->tile({8, x, 17});
            EXPECT_TRUE(!tile || tile->size() == 3000U);
        }
    }
}

TEST_F(MbtilesLoaderTest, Scribbled_NeverCrashes) {
    {
        test::MbtilesWriter writer(path());
        writer.makeTables();
        for (int x = 0; x < 32; ++x) {
            writer.putTile({8, x, 17}, std::string(700, 'a'));
        }
    }
    const auto whole = content();
    std::uint32_t random = 12345;
    const auto next = [&] { return random = random * 1664525U + 1013904223U; };
    for (int round = 0; round < 60; ++round) {
        QByteArray damaged = whole;
        for (int scribble = 0; scribble < 40; ++scribble) {
            damaged[static_cast<qsizetype>(next() % static_cast<std::uint32_t>(whole.size()))] =
                static_cast<char>(next() >> 11);
        }
        write(damaged);
        if (const auto file = open()) {
            for (int x = 0; x < 32; ++x) {
                const auto tile = file->tile({8, x, 17});
                EXPECT_TRUE(!tile || tile->size() <= tiles::MbtilesFile::kLargestTile);
            }
        }
    }
}

TEST_F(MbtilesLoaderTest, LockedByAWriter_IsAnErrorNow) {
    makeTown();
    test::MbtilesWriter writer(path());
    writer.run("BEGIN EXCLUSIVE");
    EXPECT_EQ(open(), nullptr);
    EXPECT_NE(error.find("locked"), std::string::npos) << error;
    writer.run("COMMIT");
    EXPECT_NE(open(), nullptr);
}

TEST_F(MbtilesLoaderTest, TilesInAView_AreRead) {
    {
        test::MbtilesWriter writer(path());
        writer.run(
            "CREATE TABLE map (zoom_level INTEGER, tile_column INTEGER, tile_row INTEGER, tile_id TEXT);"
            "CREATE TABLE images (tile_id TEXT, tile_data BLOB);"
            "CREATE VIEW tiles AS SELECT map.zoom_level AS zoom_level, map.tile_column AS tile_column,"
            " map.tile_row AS tile_row, images.tile_data AS tile_data"
            " FROM map JOIN images ON images.tile_id = map.tile_id;"
            "INSERT INTO map VALUES (1, 0, 1, 'a'); INSERT INTO images VALUES ('a', x'6162')");
    }
    const auto file = open();
    ASSERT_NE(file, nullptr) << error;
    EXPECT_EQ(text(file->tile({1, 0, 0})), "ab");
    EXPECT_TRUE(file->metadata().empty());
}

TEST_F(MbtilesLoaderTest, HostileViews_AreRefused) {
    const char* views[] = {
        ("WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n)"
         " SELECT i AS zoom_level, i AS tile_column, i AS tile_row, i AS tile_data FROM n"),
        "SELECT 1 AS zoom_level, 0 AS tile_column, 0 AS tile_row, zeroblob(1000000000) AS tile_data",
        "SELECT 1 AS zoom_level, 0 AS tile_column, 0 AS tile_row, load_extension('/tmp/evil') AS tile_data",
        "SELECT 1 AS zoom_level, 0 AS tile_column, 0 AS tile_row, name AS tile_data FROM pragma_table_list"};
    for (const char* view : views) {
        QFile::remove(QString::fromStdString(path()));
        {
            test::MbtilesWriter writer(path());
            writer.run(std::string("CREATE VIEW tiles AS ") + view);
        }
        const auto file = open();
        EXPECT_TRUE(!file || !file->tile({1, 0, 1})) << view;
    }
}

TEST_F(MbtilesLoaderTest, EndlessJoin_IsGivenUp) {
    {
        test::MbtilesWriter writer(path());
        writer.run("CREATE TABLE n (i INTEGER, b BLOB)");
        writer.run("BEGIN");
        for (int row = 0; row < 300; ++row) {
            writer.run("INSERT INTO n VALUES (" + std::to_string(row) + ", zeroblob(40000))");
        }
        writer.run("COMMIT");
        writer.run(
            "CREATE VIEW tiles AS SELECT a.i AS zoom_level, b.i AS tile_column, c.i AS tile_row, d.b AS tile_data"
            " FROM n a, n b, n c, n d ORDER BY d.b, c.i");
    }
    const auto file = open();
    ASSERT_NE(file, nullptr) << error;
    const auto before = sqlite3_memory_highwater(1);
    EXPECT_EQ(file->tile({5, 4, 200}), std::nullopt);
    EXPECT_EQ(file->finestLevel(), std::nullopt);
    EXPECT_LT(sqlite3_memory_highwater(0) - before, 80LL << 20);
}

TEST_F(MbtilesLoaderTest, FewStepsOfMegabytesEach_AreGivenUpByTheClock) {
    {
        test::MbtilesWriter writer(path());
        writer.run("CREATE TABLE n (i INTEGER, b BLOB)");
        writer.run("BEGIN");
        for (int row = 0; row < 10; ++row) {
            writer.run("INSERT INTO n VALUES (" + std::to_string(row) + ", zeroblob(2000000))");
        }
        writer.run("COMMIT");
        writer.run(
            "CREATE VIEW tiles AS SELECT a.i AS zoom_level, b.i AS tile_column, c.i AS tile_row, d.b AS tile_data"
            " FROM n a, n b, n c, n d, n e, n f WHERE a.b || b.b < c.b || d.b OR e.b || a.b < f.b || c.b");
    }
    const auto began = std::chrono::steady_clock::now();
    const auto file = open();
    ASSERT_NE(file, nullptr) << error;
    for (int x = 0; x < 400; ++x) {
        EXPECT_EQ(file->tile({9, x, 511}), std::nullopt);
    }
    EXPECT_EQ(file->finestLevel(), std::nullopt);
    // One second of looking, however many tiles; the rest is a busy machine's.
    EXPECT_LT(std::chrono::steady_clock::now() - began, std::chrono::seconds(15));
}

TEST_F(MbtilesLoaderTest, OddRows_AreNoTiles) {
    {
        test::MbtilesWriter writer(path());
        writer.makeTables();
        writer.run("INSERT INTO tiles VALUES (1, 0, 1, zeroblob(5000000)), (1, 1, 1, NULL), (1, 1, 0, 'text')");
        writer.run("INSERT INTO tiles VALUES ('finest', 0, 0, 'x')");
        writer.putMetadata("json", std::string(3'000'000, 'x'));
        writer.putMetadata("name", "Town");
        writer.run("INSERT INTO metadata VALUES (NULL, 'x'), ('attribution', NULL)");
    }
    const auto file = open();
    ASSERT_NE(file, nullptr) << error;
    EXPECT_EQ(text(file->tile({1, 0, 0})), "none");
    EXPECT_EQ(text(file->tile({1, 1, 0})), "none");
    EXPECT_EQ(text(file->tile({1, 1, 1})), "text");
    EXPECT_EQ(file->finestLevel(), std::nullopt);
    EXPECT_EQ(file->metadata().at("name"), "Town");
    EXPECT_EQ(file->metadata().at("json"), "");
}

TEST_F(MbtilesLoaderTest, OddNames_AreFiles) {
    makeTown();
    for (const auto& name : {QStringLiteral("a b?mode=rwc#x%41.mbtiles"), QStringLiteral("file:odd.mbtiles")}) {
        ASSERT_TRUE(QFile::copy(QString::fromStdString(path()), folder.filePath(name)));
        EXPECT_NE(MbtilesLoader::open(path(name), error), nullptr) << error;
    }
}

TEST_F(MbtilesLoaderTest, WriteAheadLogInAForeignFolder_IsReadAsItStands) {
    {
        test::MbtilesWriter writer(path());
        writer.run("PRAGMA journal_mode=WAL");
        writer.makeTables();
        writer.putTile({2, 1, 1}, "walled");
    }
    const auto file = open();
    ASSERT_NE(file, nullptr) << error;
    EXPECT_EQ(text(file->tile({2, 1, 1})), "walled");
}

}  // namespace ktr::linux_
