#include "linux/maps/VectorGround.h"

#include <libdeflate.h>

#include <QFile>
#include <QTemporaryDir>

#include "linux/maps/MapDrawer.h"
#include "linux/maps/MapStyle.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/maps/MbtilesWriter.h"
#include "tests/support/maps/TileWriter.h"

namespace ktr::linux_ {

using test::LayerWriter;
using test::MbtilesWriter;
using test::tileOf;

namespace {

constexpr tiles::TileKey kMiddle{14, 8700, 5300};

/// Fills what nobody else has drawn.
class PlainGround final : public MapGround {
  public:
    MapDrawn draw(const MapDrawing& drawing) override {
        drawing.painter.resetTransform();
        drawing.painter.setClipRegion(drawing.region);
        drawing.painter.fillRect(QRect(QPoint(), drawing.pixels), Qt::magenta);
        return {drawing.region, "Plain", true};
    }
};

std::string gzipped(const std::string& data) {
    auto* compressor = libdeflate_alloc_compressor(6);
    std::string packed(libdeflate_gzip_compress_bound(compressor, data.size()), '\0');
    packed.resize(libdeflate_gzip_compress(compressor, data.data(), data.size(), packed.data(), packed.size()));
    libdeflate_free_compressor(compressor);
    return packed;
}

/// A lake in the west of a tile, a street from north to south in the east.
std::string lakeTile() {
    return tileOf(
        {LayerWriter("water_polygons").area({{-80, -80}, {2048, -80}, {2048, 4176}, {-80, 4176}}, {{"kind", "lake"}}),
         LayerWriter("streets").line({{3200, -80}, {3200, 4176}}, {{"kind", "residential"}})});
}

}  // namespace

class VectorGroundTest : public test::PlatformTest {
  protected:
    std::string path() const { return folder.filePath(QStringLiteral("map.mbtiles")).toStdString(); }
    /// An error line is due that says why the map is not read.
    void expectUnreadable(const std::string& why) { expectErrorLine("The map " + path() + " cannot be read: " + why); }
    /// The tile fills 256 × 256 points.
    static platform::MapPictureRequest request(const tiles::TileKey& key = kMiddle, double scale = 1.0) {
        platform::MapPictureRequest made;
        platform::MapViewport world{{0.0, 0.0}, static_cast<double>(key.z), {0.0, 0.0}};
        const double half = 128.0 * std::exp2(key.z);
        made.viewport = {world.coordinateAt({key.x * 256.0 + 128.0 - half, key.y * 256.0 + 128.0 - half}),
                         static_cast<double>(key.z),
                         {256.0, 256.0}};
        made.scale = scale;
        return made;
    }
    MapDrawer::Result draw(const platform::MapPictureRequest& wanted) {
        auto result = MapDrawer::draw(wanted, {ground(), std::make_shared<PlainGround>()}, {});
        EXPECT_TRUE(result.has_value());
        result->pixels = result->whole();
        return *result;
    }
    std::shared_ptr<VectorGround> ground() {
        if (!ground_) {
            ground_ = std::make_shared<VectorGround>(path());
        }
        return ground_;
    }
    void makeFile(const std::map<std::string, std::string>& metadata,
                  const std::map<tiles::TileKey, std::string>& tiles) const {
        MbtilesWriter writer(path());
        writer.makeTables();
        for (const auto& [name, value] : metadata) {
            writer.putMetadata(name, value);
        }
        for (const auto& [key, data] : tiles) {
            writer.putTile(key, data);
        }
    }

    QTemporaryDir folder;
    const MapStyle& style = MapStyle::of(false, false);

  private:
    std::shared_ptr<VectorGround> ground_;
};

TEST_F(VectorGroundTest, Tile_IsDrawnWhereItBelongs) {
    makeFile({{"format", "pbf"},
              {"minzoom", "10"},
              {"maxzoom", "14"},
              {"attribution", "<a href='#'>&copy; Map contributors</a>"}},
             {{kMiddle, gzipped(lakeTile())}});
    const auto picture = draw(request());
    EXPECT_EQ(picture.pixels.pixelColor(64, 128), style.water);
    EXPECT_EQ(picture.pixels.pixelColor(160, 128), style.land);
    EXPECT_EQ(picture.pixels.pixelColor(200, 128), style.minor);
    EXPECT_EQ(picture.attribution, "© Map contributors");
    EXPECT_TRUE(picture.isComplete);
}

TEST_F(VectorGroundTest, Scales_ShowTheSameSharply) {
    makeFile({{"format", "pbf"}}, {{kMiddle, gzipped(lakeTile())}});
    for (const double scale : {1.0, 1.5, 2.0, 3.0}) {
        const auto picture = draw(request(kMiddle, scale));
        EXPECT_EQ(picture.pixels.size(), QSize(static_cast<int>(256 * scale), static_cast<int>(256 * scale)));
        const int middle = static_cast<int>(128 * scale);
        EXPECT_EQ(picture.pixels.pixelColor(middle - static_cast<int>(3 * scale), middle), style.water);
        EXPECT_EQ(picture.pixels.pixelColor(middle + static_cast<int>(3 * scale), middle), style.land);
    }
}

TEST_F(VectorGroundTest, Dark_AndHighContrast_HaveTheirColors) {
    makeFile({{"format", "pbf"}}, {{kMiddle, gzipped(lakeTile())}});
    auto dark = request();
    dark.isDark = true;
    EXPECT_EQ(draw(dark).pixels.pixelColor(64, 128), QColor(0x15, 0x2A, 0x31));
    dark.isHighContrast = true;
    EXPECT_EQ(draw(dark).pixels.pixelColor(200, 128), MapStyle::of(true, true).minor);
}

TEST_F(VectorGroundTest, Neighbours_MeetWithoutASeam) {
    const tiles::TileKey east{14, 8701, 5300};
    const std::string lake =
        tileOf({LayerWriter("water_polygons").area({{0, 0}, {4096, 0}, {4096, 4096}, {0, 4096}}, {{"kind", "lake"}}),
                LayerWriter("streets").line({{0, 2048}, {4096, 2048}}, {{"kind", "primary"}})});
    makeFile({{"format", "pbf"}}, {{kMiddle, lake}, {east, lake}});
    for (const double shift : {0.0, 3.3, 17.77}) {
        auto between = request(kMiddle, 1.5);
        between.viewport.zoom = 14.37;
        between.viewport.centre = between.viewport.coordinateAt({256.0 + shift, 128.0});
        const auto picture = draw(between);
        const int row = 40;
        const int street = picture.pixels.height() / 2;
        for (int x = 0; x < picture.pixels.width(); ++x) {
            ASSERT_EQ(picture.pixels.pixelColor(x, row), style.water) << x << " at " << shift;
            ASSERT_EQ(picture.pixels.pixelColor(x, street), style.major) << x << " at " << shift;
        }
    }
}

/// A soft edge that is drawn twice is a harder one, and drawing is what a picture costs.
TEST_F(VectorGroundTest, LinesThatCarryNames_AreNotDrawnAgain) {
    const LayerWriter::Spots street = {{-80, 900}, {4176, 1740}};
    const LayerWriter::Spots brook = {{-80, 2900}, {4176, 3740}};
    const auto drawn = [&](const std::vector<LayerWriter>& layers) {
        makeFile({{"format", "pbf"}}, {{kMiddle, tileOf(layers)}});
        auto result = MapDrawer::draw(request(), {std::make_shared<VectorGround>(path())}, {});
        QFile::remove(QString::fromStdString(path()));
        return result->pixels;
    };
    const auto streets = LayerWriter("streets").line(street, {{"kind", "residential"}});
    const auto brooks = LayerWriter("water_lines").line(brook, {{"kind", "river"}});
    const QImage once = drawn({streets, brooks});
    EXPECT_NE(once, drawn({streets}));
    EXPECT_EQ(once,
              drawn({streets, brooks,
                     LayerWriter("street_labels").line(street, {{"kind", "residential"}, {"name", "High Street"}}),
                     LayerWriter("water_lines_labels").line(brook, {{"kind", "river"}, {"name", "Brin"}})}));
    const auto roads = LayerWriter("transportation").line(street, {{"class", "minor"}});
    EXPECT_EQ(
        drawn({roads}),
        drawn({roads, LayerWriter("transportation_name").line(street, {{"class", "minor"}, {"name", "High Street"}})}));
}

TEST_F(VectorGroundTest, MissingTile_IsFilledFromACoarserLevel) {
    makeFile({{"format", "pbf"}, {"minzoom", "12"}, {"maxzoom", "14"}}, {{kMiddle.parent(12), gzipped(lakeTile())}});
    // Of the parent's four columns the first two are lake.
    for (int column = 0; column < 4; ++column) {
        const tiles::TileKey key{14, kMiddle.parent(12).x * 4 + column, kMiddle.parent(12).y * 4 + 1};
        const auto color = draw(request(key)).pixels.pixelColor(100, 30);
        EXPECT_EQ(color, column < 2 ? style.water : column == 3 ? style.land : QColor(Qt::magenta)) << column;
    }
}

TEST_F(VectorGroundTest, DamagedTile_IsFilledFromACoarserLevel) {
    const std::string packed = gzipped(lakeTile());
    const std::string bomb = gzipped(std::string(std::size_t{64} << 20, '\0'));
    ASSERT_LT(bomb.size(), tiles::MbtilesFile::kLargestTile);
    for (const std::string& damaged :
         {std::string("no tile at all"), packed.substr(0, packed.size() / 2), bomb, lakeTile().substr(0, 30)}) {
        QFile::remove(QString::fromStdString(path()));
        makeFile({{"format", "pbf"}}, {{kMiddle, damaged}, {{14, 1, 1}, packed}, {kMiddle.parent(12), packed}});
        VectorGround fresh(path());
        const auto west = tiles::TileKey{14, kMiddle.parent(12).x * 4, kMiddle.y};
        const auto picture = draw(request(west));
        EXPECT_EQ(picture.pixels.pixelColor(30, 30), style.water);
        const auto own = draw(request());
        EXPECT_NE(own.pixels.pixelColor(30, 30), QColor(Qt::black));
    }
}

TEST_F(VectorGroundTest, TangledLinesAndNamesWithoutEnd_AreDrawnInTime) {
    // Each of these would take minutes if it were drawn whole.
    std::vector<std::uint32_t> tangle = {9, 0, 0, 200'000U << 3 | 2U};
    for (int i = 0; i < 200'000; ++i) {
        tangle.push_back(i % 2 == 0 ? 6000U : 5999U);
        tangle.push_back(i % 2 == 0 ? 8000U : 7999U);
    }
    LayerWriter names("streets");
    for (int i = 0; i < 3000; ++i) {
        names.line({{0, i}, {2000, 4000 - i}, {4096, i}},
                   {{"kind", "primary"}, {"name", std::to_string(i) + " Street"}});
    }
    makeFile({{"format", "pbf"}},
             {{kMiddle, tileOf({LayerWriter("streets").raw(2, tangle, {{"kind", "footway"}}), names})}});
    auto near = request(kMiddle, 2.0);
    near.viewport.zoom = 15.5;
    EXPECT_EQ(draw(near).pixels.size(), QSize(512, 512));
    EXPECT_EQ(draw(request()).pixels.size(), QSize(256, 256));
}

TEST_F(VectorGroundTest, OutsideItsBounds_OthersDraw) {
    // The tile's eastern half, in degrees.
    const auto viewport = request().viewport;
    const auto from = viewport.coordinateAt({128.0, 256.0});
    const auto to = viewport.coordinateAt({256.0, 0.0});
    makeFile({{"format", "pbf"},
              {"bounds", std::to_string(from.longitude) + "," + std::to_string(from.latitude) + "," +
                             std::to_string(to.longitude) + "," + std::to_string(to.latitude)}},
             {{kMiddle, lakeTile()}});
    const auto picture = draw(request());
    EXPECT_EQ(picture.pixels.pixelColor(64, 128), QColor(Qt::magenta));
    EXPECT_EQ(picture.pixels.pixelColor(200, 128), style.minor);
    EXPECT_EQ(picture.attribution, "Offline map · Plain");
}

TEST_F(VectorGroundTest, NothingToRead_DrawsNothing) {
    expectUnreadable("No such file or directory");
    expectUnreadable("file is not a database");
    EXPECT_EQ(draw(request()).pixels.pixelColor(5, 5), QColor(Qt::magenta));
    EXPECT_EQ(draw(request()).attribution, "Plain");
    QFile file(QString::fromStdString(path()));
    ASSERT_TRUE(file.open(QIODevice::WriteOnly));
    file.write("no map");
    file.close();
    EXPECT_EQ(draw(request()).pixels.pixelColor(5, 5), QColor(Qt::magenta));
}

TEST_F(VectorGroundTest, Pictures_AreAnothersGround) {
    makeFile({{"format", "png"}}, {{kMiddle, "\x89PNG"}});
    EXPECT_EQ(draw(request()).pixels.pixelColor(5, 5), QColor(Qt::magenta));
}

TEST_F(VectorGroundTest, Level99_AndNonsenseInTheMetadata_AreSurvived) {
    expectUnreadable("no tiles");
    for (const auto& [lowest, highest] : {std::pair("99", "99"), std::pair("-5", "x"), std::pair("14", "3")}) {
        QFile::remove(QString::fromStdString(path()));
        makeFile({{"format", "pbf"}, {"minzoom", lowest}, {"maxzoom", highest}, {"bounds", "nan,1e400,,"}},
                 {{kMiddle, lakeTile()}});
        const auto result =
            MapDrawer::draw(request(), {std::make_shared<VectorGround>(path()), std::make_shared<PlainGround>()}, {});
        ASSERT_TRUE(result.has_value());
        const auto color = result->pixels.pixelColor(64, 128);
        EXPECT_TRUE(color == style.water || color == QColor(Qt::magenta));
    }
}

TEST_F(VectorGroundTest, NewFile_IsReadAgain) {
    expectUnreadable("No such file or directory");
    EXPECT_EQ(draw(request()).pixels.pixelColor(64, 128), QColor(Qt::magenta));
    makeFile({{"format", "pbf"}}, {{kMiddle, lakeTile()}});
    EXPECT_EQ(draw(request()).pixels.pixelColor(64, 128), style.water);
}

TEST_F(VectorGroundTest, Edges_OfTheWorld_AreDrawn) {
    makeFile({{"format", "pbf"}, {"minzoom", "0"}, {"maxzoom", "1"}},
             {{{1, 0, 0}, lakeTile()}, {{1, 1, 0}, lakeTile()}, {{1, 0, 1}, lakeTile()}, {{1, 1, 1}, lakeTile()}});
    for (const double longitude : {180.0, -180.0, 0.0}) {
        for (const double latitude : {90.0, -90.0, 0.0}) {
            platform::MapPictureRequest wide;
            wide.viewport = {{latitude, longitude}, 1.0, {700.0, 300.0}};
            const auto picture = draw(wide);
            EXPECT_EQ(picture.pixels.size(), QSize(700, 300));
            EXPECT_NE(picture.pixels.pixelColor(350, latitude > 0.0 ? 200 : 100), QColor(Qt::magenta));
        }
    }
}

TEST_F(VectorGroundTest, Stopped_GivesNothing) {
    makeFile({{"format", "pbf"}}, {{kMiddle, lakeTile()}});
    std::stop_source stop;
    stop.request_stop();
    EXPECT_FALSE(MapDrawer::draw(request(), {ground()}, stop.get_token()).has_value());
}

}  // namespace ktr::linux_
