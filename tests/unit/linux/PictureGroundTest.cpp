#include "linux/maps/PictureGround.h"

#include <QBuffer>
#include <QFile>
#include <QTemporaryDir>
#include <cmath>
#include <map>

#include "linux/maps/AttributedGround.h"
#include "linux/maps/MapDrawer.h"
#include "linux/maps/MapStyle.h"
#include "linux/maps/MbtilesPictures.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/maps/MbtilesWriter.h"

namespace ktr::linux_ {

using test::MbtilesWriter;

namespace {

constexpr tiles::TileKey kMiddle{10, 540, 330};

std::string png(const QImage& image) {
    QByteArray data;
    QBuffer buffer(&data);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "PNG");
    return data.toStdString();
}

std::string plain(const QColor& color, int side = 256) {
    QImage image(side, side, color.alpha() == 255 ? QImage::Format_RGB32 : QImage::Format_ARGB32);
    image.fill(color);
    return png(image);
}

/// West half red, east half blue.
std::string halves() {
    QImage image(256, 256, QImage::Format_RGB32);
    image.fill(Qt::red);
    for (int y = 0; y < 256; ++y) {
        for (int x = 128; x < 256; ++x) {
            image.setPixelColor(x, y, Qt::blue);
        }
    }
    return png(image);
}

class RestGround final : public MapGround {
  public:
    MapDrawn draw(const MapDrawing& drawing) override {
        drawing.painter.resetTransform();
        drawing.painter.setClipRegion(drawing.region);
        drawing.painter.fillRect(QRect(QPoint(), drawing.pixels), Qt::magenta);
        return {drawing.region, "Rest", true};
    }
};

}  // namespace

class PictureGroundTest : public test::PlatformTest {
  protected:
    std::string path() const { return folder.filePath(QStringLiteral("map.mbtiles")).toStdString(); }
    void write(const std::vector<std::pair<tiles::TileKey, std::string>>& tiles,
               const std::vector<std::pair<std::string, std::string>>& metadata = {{"format", "png"}}) {
        MbtilesWriter writer(path());
        writer.makeTables();
        for (const auto& [name, value] : metadata) {
            writer.putMetadata(name, value);
        }
        for (const auto& [key, data] : tiles) {
            writer.putTile(key, data);
        }
    }
    /// The tile fills 256 × 256 points.
    static platform::MapPictureRequest request(const tiles::TileKey& key = kMiddle) {
        platform::MapPictureRequest made;
        const platform::MapViewport world{{0.0, 0.0}, static_cast<double>(key.z), {0.0, 0.0}};
        const double half = 128.0 * std::exp2(key.z);
        made.viewport = {world.coordinateAt({key.x * 256.0 + 128.0 - half, key.y * 256.0 + 128.0 - half}),
                         static_cast<double>(key.z),
                         {256.0, 256.0}};
        return made;
    }
    MapDrawer::Result draw(const platform::MapPictureRequest& wanted = request()) {
        const auto drawn = MapDrawer::draw(wanted, {ground, std::make_shared<RestGround>()}, {});
        EXPECT_TRUE(drawn.has_value());
        return drawn.value_or(MapDrawer::Result());
    }

    QTemporaryDir folder;
    std::shared_ptr<MapGround> ground = std::make_shared<PictureGround>(std::make_unique<MbtilesPictures>(path()));
};

TEST_F(PictureGroundTest, ATile_IsDrawnWhereItIs) {
    write({{kMiddle, halves()}}, {{"format", "png"}, {"attribution", "<b>&copy; Somebody</b>"}});
    const auto drawn = draw();
    EXPECT_EQ(drawn.pixels.pixelColor(20, 128), QColor(Qt::red));
    EXPECT_EQ(drawn.pixels.pixelColor(236, 128), QColor(Qt::blue));
    EXPECT_EQ(drawn.attribution, "© Somebody");
    EXPECT_TRUE(drawn.isComplete);
}

TEST_F(PictureGroundTest, AMissingTile_IsFilledFromItsParent) {
    // The tile is the parent's north-west quarter.
    write({{kMiddle.parent(9), halves()}, {{10, 0, 0}, plain(Qt::green)}});
    const auto drawn = draw();
    EXPECT_EQ(drawn.pixels.pixelColor(10, 10), QColor(Qt::red));
    EXPECT_EQ(drawn.pixels.pixelColor(240, 240), QColor(Qt::red));
    auto east = kMiddle;
    ++east.x;
    EXPECT_EQ(draw(request(east)).pixels.pixelColor(128, 128), QColor(Qt::blue));
}

/// Pictures that are at hand, and which were wanted.
class ListedPictures final : public TilePictures {
  public:
    std::map<tiles::TileKey, Answer> answers;
    std::vector<tiles::TileKey> wanted;

    bool open() override { return true; }
    int coarsest() const override { return 0; }
    int finest() const override { return 19; }
    std::string attribution() const override { return "Listed"; }
    Answer tile(const tiles::TileKey& key, bool isWanted) override {
        if (isWanted) {
            wanted.push_back(key);
        }
        const auto found = answers.find(key);
        return found == answers.end() ? Answer{} : found->second;
    }
};

TEST_F(PictureGroundTest, ACoarserTile_IsFetchedOnlyWhereThereIsNoFinerOne) {
    auto owned = std::make_unique<ListedPictures>();
    ListedPictures& pictures = *owned;
    ground = std::make_shared<PictureGround>(std::move(owned));
    pictures.answers[kMiddle] = {std::nullopt, true, 0};
    EXPECT_FALSE(draw().isComplete);
    EXPECT_EQ(pictures.wanted, std::vector({kMiddle}));
    // The server has none: the coarser one is worth fetching, and those above it are not while it comes.
    pictures.wanted.clear();
    pictures.answers[kMiddle] = {};
    pictures.answers[kMiddle.parent(9)] = {std::nullopt, true, 0};
    EXPECT_FALSE(draw().isComplete);
    EXPECT_EQ(pictures.wanted, std::vector({kMiddle, kMiddle.parent(9)}));
}

TEST_F(PictureGroundTest, FinerPixels_TakeFinerTiles) {
    auto owned = std::make_unique<ListedPictures>();
    ListedPictures& pictures = *owned;
    ground = std::make_shared<PictureGround>(std::move(owned));
    // A tile of 256 pixels is never drawn much larger than that, nor so small that its writing cannot be read.
    for (const auto& [scale, level] :
         {std::pair(1.0, 10), std::pair(1.5, 10), std::pair(2.0, 11), std::pair(3.0, 11)}) {
        pictures.wanted.clear();
        auto asked = request();
        asked.scale = scale;
        draw(asked);
        ASSERT_FALSE(pictures.wanted.empty());
        EXPECT_EQ(pictures.wanted.front().z, level) << scale;
    }
}

TEST_F(PictureGroundTest, WhatShowsThrough_IsLand) {
    write({{kMiddle, plain(Qt::transparent)}});
    EXPECT_EQ(draw().pixels.pixelColor(128, 128), QColor(MapStyle::of(false, false).land));
    auto dark = request();
    dark.isDark = true;
    EXPECT_LT(draw(dark).pixels.pixelColor(128, 128).lightness(), 40);
}

TEST_F(PictureGroundTest, WhereThereIsNothing_TheNextGroundDraws) {
    write({{kMiddle, plain(Qt::red)}});
    auto far = kMiddle;
    far.x += 40;
    const auto drawn = draw(request(far));
    EXPECT_EQ(drawn.pixels.pixelColor(128, 128), QColor(Qt::magenta));
    EXPECT_EQ(drawn.attribution, "Rest");
}

TEST_F(PictureGroundTest, Bounds_AreKept) {
    const auto middle = request().viewport.centre;
    write({{kMiddle, plain(Qt::red)}},
          {{"format", "png"}, {"bounds", std::to_string(middle.longitude) + ",-80,180,80"}});
    const auto drawn = draw();
    EXPECT_EQ(drawn.pixels.pixelColor(10, 128), QColor(Qt::magenta));
    EXPECT_EQ(drawn.pixels.pixelColor(240, 128), QColor(Qt::red));
}

TEST_F(PictureGroundTest, DamagedPictures_CountAsMissing) {
    const std::string good = plain(Qt::blue);
    for (const std::string& bad :
         {good.substr(0, 40), std::string("no picture at all"), std::string(), plain(Qt::red, 5000),
          std::string("<svg xmlns='http://www.w3.org/2000/svg' width='256' height='256'><rect/></svg>")}) {
        QFile::remove(QString::fromStdString(path()));
        write({{kMiddle, bad}, {kMiddle.parent(9), good}});
        ground = std::make_shared<PictureGround>(std::make_unique<MbtilesPictures>(path()));
        EXPECT_EQ(draw().pixels.pixelColor(128, 128), QColor(Qt::blue)) << bad.substr(0, 10);
    }
}

TEST_F(PictureGroundTest, ALargePicture_IsReadSmaller) {
    write({{kMiddle, plain(Qt::red, 3000)}});
    EXPECT_EQ(draw().pixels.pixelColor(128, 128), QColor(Qt::red));
}

TEST_F(PictureGroundTest, VectorTilesAndNoFile_AreLeftToOthers) {
    EXPECT_EQ(draw().pixels.pixelColor(128, 128), QColor(Qt::magenta));
    write({{kMiddle, plain(Qt::red)}}, {{"format", "pbf"}});
    ground = std::make_shared<PictureGround>(std::make_unique<MbtilesPictures>(path()));
    EXPECT_EQ(draw().pixels.pixelColor(128, 128), QColor(Qt::magenta));
}

TEST_F(PictureGroundTest, AttributedGround_SaysWhatIsConfigured) {
    write({{kMiddle, plain(Qt::red)}}, {{"format", "png"}, {"attribution", "Theirs"}});
    ground = std::make_shared<AttributedGround>(ground, "Mine");
    EXPECT_EQ(draw().attribution, "Mine");
    auto far = kMiddle;
    far.x += 40;
    EXPECT_EQ(draw(request(far)).attribution, "Rest");
}

TEST_F(PictureGroundTest, InTheDark_LightnessTurnsOverAndHuesStay) {
    QImage image(4, 1, QImage::Format_RGB32);
    image.setPixelColor(0, 0, Qt::white);
    image.setPixelColor(1, 0, Qt::black);
    image.setPixelColor(2, 0, QColor(0xFFC3D8DC));
    image.setPixelColor(3, 0, QColor(0xFFFFF1CF));
    PictureGround::darken(image);
    EXPECT_EQ(image.pixelColor(0, 0), QColor(Qt::black));
    EXPECT_EQ(image.pixelColor(1, 0), QColor(0xFFE8DFD2));
    // Water: 255 − 195 − 220 = −160 to each, 35 56 60; gray 51.8; 0.6 of the way from it; times the tone.
    EXPECT_EQ(image.pixelColor(2, 0), QColor(38, 48, 47));
    EXPECT_GT(image.pixelColor(3, 0).red(), image.pixelColor(3, 0).blue());
    EXPECT_LT(image.pixelColor(3, 0).lightness(), 60);

    write({{kMiddle, plain(Qt::white)}});
    auto dark = request();
    dark.isDark = true;
    EXPECT_EQ(draw(dark).pixels.pixelColor(128, 128), QColor(Qt::black));
    EXPECT_EQ(draw().pixels.pixelColor(128, 128), QColor(Qt::white));
}

}  // namespace ktr::linux_
