#include "linux/maps/ConfiguredMaps.h"

#include <libdeflate.h>
#include <sys/stat.h>

#include <QBuffer>
#include <QFile>
#include <QTemporaryDir>
#include <algorithm>
#include <fstream>
#include <functional>

#include "linux/maps/MapDrawer.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/RedactedLogSink.h"
#include "tests/support/maps/MbtilesWriter.h"
#include "tests/support/maps/TileWriter.h"

namespace ktr::linux_ {

using test::LayerWriter;
using test::MbtilesWriter;

namespace {

/// Over a coast, where no demo is.
constexpr platform::Coordinate kPlace{53.3, -6.0};
constexpr double kZoom = 9.0;
#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr long kMostGrowth = 2L << 30;  // theirs
#else
constexpr long kMostGrowth = 64L << 20;
#endif

std::string gzipped(const std::string& data) {
    auto* compressor = libdeflate_alloc_compressor(6);
    std::string packed(libdeflate_gzip_compress_bound(compressor, data.size()), '\0');
    packed.resize(libdeflate_gzip_compress(compressor, data.data(), data.size(), packed.data(), packed.size()));
    libdeflate_free_compressor(compressor);
    return packed;
}

/// A picture whose header promises `side` × `side` pixels.
std::string pngOf(int side) {
    QImage image(side, side, QImage::Format_Mono);
    image.fill(0);
    QByteArray data;
    QBuffer buffer(&data);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "PNG");
    return data.toStdString();
}

/// A street without end: every point is one more of the tile's corners.
std::string crowdedTile() {
    std::vector<std::uint32_t> commands = {9, 0, 0};
    constexpr std::uint32_t kPoints = 1'500'000;
    commands.push_back(kPoints << 3 | 2U);
    for (std::uint32_t i = 0; i < kPoints; ++i) {
        commands.push_back(i % 2 == 0 ? 8190U : 8189U);
        commands.push_back(2);
    }
    return test::tileOf({LayerWriter("streets").raw(2, commands, {{"kind", "residential"}})});
}

}  // namespace

class ConfiguredMapsTest : public test::PlatformTest {
  protected:
    std::string path(const std::string& name = "map.mbtiles") const {
        return folder.filePath(QString::fromStdString(name)).toStdString();
    }
    MapDrawer::Result draw(const Configuration& configuration) {
        platform::MapPictureRequest request;
        request.viewport = {kPlace, kZoom, {400.0, 219.0}};
        auto drawn = MapDrawer::draw(request, ConfiguredMaps::grounds(configuration, KTR_RESOURCES), {});
        EXPECT_TRUE(drawn.has_value());
        drawn->pixels = drawn->whole();
        return *drawn;
    }
    MapDrawer::Result drawFile() {
        Configuration configuration;
        configuration.maps.sources.push_back({path(), "", std::nullopt, 0, 19});
        return draw(configuration);
    }
    /// Every tile of some levels is the same.
    void write(const std::string& format, const std::string& tile, int coarsest = 0) {
        QFile::remove(QString::fromStdString(path()));
        MbtilesWriter writer(path());
        writer.makeTables();
        writer.putMetadata("format", format);
        for (int z = coarsest; z <= 9; ++z) {
            const auto count = static_cast<double>(1 << z);
            const int x = static_cast<int>((kPlace.longitude / 360.0 + 0.5) * count);
            const int y = static_cast<int>(0.3228 * count);
            for (int dx = -2; dx <= 2; ++dx) {
                for (int dy = -2; dy <= 2; ++dy) {
                    if (x + dx >= 0 && y + dy >= 0 && x + dx < (1 << z) && y + dy < (1 << z)) {
                        writer.putTile({z, x + dx, y + dy}, tile);
                    }
                }
            }
        }
    }
    /// How much more memory than now this process has at most while it works; bytes.
    static long growth(const std::function<void()>& work) {
        std::ofstream("/proc/self/clear_refs") << 5;  // forgets the peak (proc(5))
        const long before = status("VmRSS:");
        work();
        return status("VmHWM:") - before;
    }
    static long status(const std::string& field) {
        std::ifstream stream("/proc/self/status");
        for (std::string word; stream >> word;) {
            if (word == field) {
                long kibibytes = 0;
                stream >> kibibytes;
                return kibibytes * 1024;
            }
        }
        ADD_FAILURE() << field;
        return 0;
    }

    /// An error line is due that says why the map is not read.
    void expectUnreadable(const std::string& why) { expectErrorLine("The map " + path() + " cannot be read: " + why); }

    QTemporaryDir folder;
};

TEST_F(ConfiguredMapsTest, NothingConfigured_IsTheBuiltInWorld) {
    const auto drawn = draw({});
    EXPECT_EQ(drawn.attribution, "Natural Earth");
    EXPECT_TRUE(drawn.isComplete);
    EXPECT_NE(drawn.pixels.pixelColor(5, 110), drawn.pixels.pixelColor(395, 110));
}

TEST_F(ConfiguredMapsTest, AFileOfPicturesThatAreNotRead_IsSaid) {
    write("webp", std::string("RIFF\x1a\0\0\0WEBPVP8L", 16));
    EXPECT_EQ(drawFile().attribution, "Natural Earth");
    const std::string line = "The map " + path() + " cannot be read: its pictures are WebP; PNG and JPEG are read";
    EXPECT_TRUE(log->has(platform::LogLevel::Error, line));
    expectErrorLine(line);
}

TEST_F(ConfiguredMapsTest, AFileThatCannotBeRead_IsOneErrorLineWithItsReason) {
    std::ofstream(path()) << "no map";
    EXPECT_EQ(drawFile().attribution, "Natural Earth");
    const auto lines = log->lines();
    EXPECT_EQ(std::count_if(lines.begin(), lines.end(),
                            [&](const auto& line) { return line.text.find(path()) != std::string::npos; }),
              1);
    const auto errors = log->texts(platform::LogLevel::Error);
    ASSERT_EQ(errors.size(), 1U);
    EXPECT_EQ(errors[0].find("The map " + path() + " cannot be read: "), 0U);
    expectErrorLine(errors[0]);
}

TEST_F(ConfiguredMapsTest, AFile_ComesBeforeTheWorld) {
    write("png", pngOf(256));
    EXPECT_EQ(drawFile().attribution, "Offline map");
}

TEST_F(ConfiguredMapsTest, HostileTiles_LeaveTheBuiltInWorld) {
    const auto world = draw({});
    const std::string vector = test::tileOf({LayerWriter("streets").line({{0, 0}, {99, 99}}, {{"kind", "primary"}})});
    const std::string packed = gzipped(vector);
    for (const auto& [format, tile] :
         {std::pair<std::string, std::string>{"pbf", "no tile"},
          {"pbf", packed.substr(0, packed.size() / 2)},
          {"pbf", gzipped(std::string(std::size_t{200} << 20, '\0'))},
          {"pbf", gzipped(gzipped(std::string(std::size_t{100} << 20, '\0')))},
          {"pbf", ""},
          {"png", "no picture"},
          {"png", pngOf(30000)},
          {"png", pngOf(256).substr(0, 60)},
          {"jpg", "\xFF\xD8\xFF no more"},
          {"png", "<svg xmlns='http://www.w3.org/2000/svg' width='9' height='9'><image href='/etc/passwd'/></svg>"},
          {"exe", "MZ"}}) {
        write(format, tile);
        MapDrawer::Result drawn;
        EXPECT_LT(growth([&] { drawn = drawFile(); }), kMostGrowth) << format << tile.size();
        EXPECT_EQ(drawn.pixels, world.pixels) << format << tile.size();
        EXPECT_EQ(drawn.attribution, world.attribution);
    }
}

TEST_F(ConfiguredMapsTest, CrowdedTiles_AreDrawnWithinBounds) {
    write("pbf", crowdedTile(), 9);
    EXPECT_LT(growth([&] { EXPECT_EQ(drawFile().pixels.size(), QSize(400, 219)); }), kMostGrowth);
}

TEST_F(ConfiguredMapsTest, FilesThatAreNone_LeaveTheBuiltInWorld) {
    for (const char* why : {"No such file or directory", "not a file", "file is not a database"}) {
        expectUnreadable(why);
    }
    const auto world = draw({});
    EXPECT_EQ(drawFile().pixels, world.pixels);
    // A pipe that nobody writes to would be waited for.
    ASSERT_EQ(mkfifo(path().c_str(), 0600), 0);
    EXPECT_EQ(drawFile().pixels, world.pixels);
    QFile::remove(QString::fromStdString(path()));
    ASSERT_EQ(mkdir(path().c_str(), 0700), 0);
    EXPECT_EQ(drawFile().pixels, world.pixels);
    ASSERT_EQ(rmdir(path().c_str()), 0);
    std::ofstream(path()) << "SQLite format 3" << std::string(100, '\0') << "and then nothing";
    EXPECT_EQ(drawFile().pixels, world.pixels);
}

TEST_F(ConfiguredMapsTest, ALockedFile_LeavesTheBuiltInWorld) {
    expectUnreadable("database is locked");
    write("png", pngOf(256));
    MbtilesWriter writer(path());
    writer.run("BEGIN EXCLUSIVE");
    EXPECT_EQ(drawFile().pixels, draw({}).pixels);
    writer.run("COMMIT");
    EXPECT_EQ(drawFile().attribution, "Offline map");
}

TEST_F(ConfiguredMapsTest, TheConfiguredAttribution_IsShown) {
    write("png", pngOf(256));
    Configuration configuration;
    configuration.maps.sources.push_back({path(), "", "© Somebody", 0, 19});
    EXPECT_EQ(draw(configuration).attribution, "© Somebody");
}

TEST_F(ConfiguredMapsTest, Datum_IsTheConfigured) {
    constexpr platform::Coordinate kBeijing{39.9, 116.4};
    Configuration configuration;
    EXPECT_FALSE(ConfiguredMaps::make(configuration, KTR_RESOURCES, time)->isInGcj02(kBeijing));
    configuration.maps.datum = Configuration::Maps::Datum::Gcj02;
    const auto maps = ConfiguredMaps::make(configuration, KTR_RESOURCES, time);
    EXPECT_TRUE(maps->isInGcj02(kBeijing));
    EXPECT_FALSE(maps->isInGcj02({22.28, 114.16}));
}

TEST_F(ConfiguredMapsTest, WithoutTheBuiltInMap_FileAndRemedyAreSaidOnce_Readably) {
    const auto said = std::make_shared<test::RedactedLogSink>();
    platform->logSink = said;
    const auto line = [](const std::string& missing) {
        return "The built-in map /nowhere/maps/world.bin cannot be used: there is no such file. " + missing +
               "; it comes with ktr: install it again, or name the folder that has maps/world.bin in KTR_RESOURCES";
    };
    const auto grounds = ConfiguredMaps::grounds({}, "/nowhere");
    platform::MapPictureRequest request;
    request.viewport = {kPlace, kZoom, {400.0, 219.0}};
    for (int i = 0; i < 2; ++i) {
        MapDrawer::draw(request, grounds, {});
    }
    ASSERT_EQ(said->texts().size(), 2U) << "the demo's map is not there either";
    EXPECT_EQ(said->texts().back(), line("Land without shores and names is drawn"));
    Configuration configuration;
    configuration.maps.datum = Configuration::Maps::Datum::Gcj02;
    EXPECT_FALSE(ConfiguredMaps::make(configuration, "/nowhere", time)->isInGcj02({39.9, 116.4}));
    EXPECT_EQ(said->texts().back(), line("No place is shifted for maps in GCJ-02"));
}

}  // namespace ktr::linux_
