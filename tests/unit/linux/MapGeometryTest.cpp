#include <gtest/gtest.h>

#include <cmath>

#include "linux/maps/LineJoiner.h"
#include "linux/maps/MapScale.h"
#include "linux/maps/MapStyle.h"
#include "linux/maps/MapTiles.h"
#include "linux/maps/TileCache.h"
#include "linux/maps/TileGeometry.h"

namespace ktr::linux_ {

namespace {

constexpr auto kArea = tiles::MapTile::Shape::Areas;
constexpr auto kLines = tiles::MapTile::Shape::Lines;

VisibleTile tileWith(tiles::MapTile::Shape shape, const std::vector<tiles::MapTile::Spot>& spots,
                     const QRectF& window) {
    auto tile = std::make_shared<tiles::MapTile>();
    tile->spots = spots;
    tile->partEnds = {static_cast<std::uint32_t>(spots.size())};
    tiles::MapTile::Feature feature;
    feature.shape = shape;
    feature.partCount = 1;
    feature.left = feature.top = 1e9F;
    feature.right = feature.bottom = -1e9F;
    for (const auto& spot : spots) {
        feature.left = std::min(feature.left, spot.x);
        feature.right = std::max(feature.right, spot.x);
        feature.top = std::min(feature.top, spot.y);
        feature.bottom = std::max(feature.bottom, spot.y);
    }
    tile->features = {feature};
    return {tile, QRectF(0.0, 0.0, 256.0, 256.0), window};
}

const QRectF kWhole(0.0, 0.0, 256.0, 256.0);

std::vector<PlacedTile> tilesOf(const platform::MapPictureRequest& request, int level) {
    QImage image(1, 1, QImage::Format_RGB32);
    QPainter painter(&image);
    const QSize pixels(static_cast<int>(std::lround(request.viewport.size.width * request.scale)),
                       static_cast<int>(std::lround(request.viewport.size.height * request.scale)));
    return MapTiles::of({request, painter, painter, pixels, QRegion(QRect(QPoint(), pixels)), {}}, level);
}

}  // namespace

TEST(TileGeometryTest, Area_IsCutAtTheTilesEdge) {
    const auto visible = tileWith(kArea, {{-1600, 1600}, {3200, 1600}, {3200, 3200}, {-1600, 3200}}, kWhole);
    const TileGeometry geometry(visible);
    const auto& feature = visible.tile->features[0];
    EXPECT_TRUE(geometry.isVisible(feature));
    EXPECT_FALSE(geometry.isInside(feature));
    QPainterPath path;
    geometry.addArea(feature, path);
    EXPECT_EQ(path.boundingRect(), QRectF(0.0, 100.0, 200.0, 100.0));
}

TEST(TileGeometryTest, Edges_LeaveOutTheCutAlongTheTile) {
    // Cut by the tile's maker exactly at its western edge.
    const auto visible = tileWith(kArea, {{0, 1600}, {3200, 1600}, {3200, 3200}, {0, 3200}}, kWhole);
    std::vector<QPolygonF> edges;
    TileGeometry(visible).eachEdge(visible.tile->features[0],
                                   [&](const QPolygonF& piece, double) { edges.push_back(piece); });
    ASSERT_EQ(edges.size(), 1U);
    EXPECT_EQ(edges[0], QPolygonF({{0.0, 100.0}, {200.0, 100.0}, {200.0, 200.0}, {0.0, 200.0}}));
}

TEST(TileGeometryTest, Edges_OfAWholeAreaAreClosed) {
    const auto visible = tileWith(kArea, {{160, 160}, {320, 160}, {320, 320}}, kWhole);
    std::vector<QPolygonF> edges;
    TileGeometry(visible).eachEdge(visible.tile->features[0],
                                   [&](const QPolygonF& piece, double) { edges.push_back(piece); });
    ASSERT_EQ(edges.size(), 1U);
    EXPECT_EQ(edges[0].first(), edges[0].last());
    EXPECT_EQ(edges[0].size(), 4);
}

TEST(TileGeometryTest, Line_IsCutIntoItsPieces) {
    const auto visible = tileWith(kLines, {{800, 800}, {800, 4896}, {1600, 4896}, {1600, 800}}, kWhole);
    std::vector<std::pair<QPolygonF, double>> pieces;
    TileGeometry(visible).eachLine(visible.tile->features[0],
                                   [&](const QPolygonF& piece, double from) { pieces.emplace_back(piece, from); });
    ASSERT_EQ(pieces.size(), 2U);
    EXPECT_EQ(pieces[0].first, QPolygonF({{50.0, 50.0}, {50.0, 256.0}}));
    EXPECT_EQ(pieces[0].second, 0.0);
    EXPECT_EQ(pieces[1].first, QPolygonF({{100.0, 256.0}, {100.0, 50.0}}));
    EXPECT_DOUBLE_EQ(pieces[1].second, 256.0 + 50.0 + 50.0);
}

TEST(TileGeometryTest, OutsideItsWindow_IsNothing) {
    const auto visible = tileWith(kLines, {{800, 800}, {1600, 800}}, QRectF(0.0, 100.0, 256.0, 100.0));
    const TileGeometry geometry(visible);
    EXPECT_FALSE(geometry.isVisible(visible.tile->features[0]));
    geometry.eachLine(visible.tile->features[0], [](const QPolygonF&, double) { ADD_FAILURE(); });
    EXPECT_TRUE(geometry.spots(visible.tile->features[0]).empty());
}

TEST(LineJoinerTest, PiecesOfOneStreet_AreJoinedWhicheverWayTheyRun) {
    const auto joined = joinLines({QPolygonF({{0, 0}, {10, 0}}), QPolygonF({{30, 1}, {20, 0}}),
                                   QPolygonF({{10, 0}, {20, 0}}), QPolygonF({{0, 50}, {5, 50}})});
    ASSERT_EQ(joined.size(), 2U);
    EXPECT_EQ(joined[0].size(), 4);
    EXPECT_NEAR(lengthOf(joined[0]), 30.05, 0.01);
    EXPECT_EQ(lengthOf(joined[1]), 5.0);
}

TEST(LineJoinerTest, SharpTurn_IsNotFollowed) {
    const auto joined =
        joinLines({QPolygonF({{0, 0}, {10, 0}}), QPolygonF({{10, 0}, {10, 30}}), QPolygonF({{10, 0}, {20, 2}})});
    ASSERT_EQ(joined.size(), 2U);
    EXPECT_EQ(joined[0], QPolygonF({{10, 0}, {10, 30}}));
    EXPECT_EQ(joined[1].size(), 3);
}

TEST(LineJoinerTest, NothingToJoin_IsNothing) {
    EXPECT_TRUE(joinLines({}).empty());
    EXPECT_TRUE(joinLines({QPolygonF(), QPolygonF({{1, 1}}), QPolygonF({{2, 2}, {2, 2}})}).empty());
    EXPECT_LE(joinLines(std::vector<QPolygonF>(5000, QPolygonF({{0, 0}, {1, 0}}))).size(), 300U);
}

TEST(MapScaleTest, Widths_AreThoseOfTheTable) {
    struct Row {
        double metres, major, majorCasing, secondary, secondaryCasing, minor, minorCasing;
    };
    for (const auto& row : {Row{25.0, 2.6, 3.6, 1.4, 2.2, 0.6, 0.0}, Row{12.0, 3.8, 5.0, 2.4, 3.4, 1.1, 0.0},
                            Row{6.0, 5.8, 7.6, 4.2, 5.6, 2.2, 3.0}, Row{4.0, 7.6, 9.6, 5.9, 7.4, 4.0, 5.1},
                            Row{2.2, 9.5, 12.0, 7.4, 9.2, 5.0, 6.4}, Row{1.2, 15.0, 19.0, 12.0, 15.0, 8.0, 10.0},
                            Row{0.9, 18.0, 23.0, 14.0, 17.5, 9.5, 12.0}, Row{0.2, 18.0, 23.0, 14.0, 17.5, 9.5, 12.0}}) {
        const MapScale scale(row.metres);
        EXPECT_DOUBLE_EQ(scale.road(tiles::MapKind::Major).fill, row.major) << row.metres;
        EXPECT_DOUBLE_EQ(scale.road(tiles::MapKind::Major).casing, row.majorCasing) << row.metres;
        EXPECT_DOUBLE_EQ(scale.road(tiles::MapKind::Secondary).fill, row.secondary) << row.metres;
        EXPECT_DOUBLE_EQ(scale.road(tiles::MapKind::Secondary).casing, row.secondaryCasing) << row.metres;
        EXPECT_DOUBLE_EQ(scale.road(tiles::MapKind::Minor).fill, row.minor) << row.metres;
        EXPECT_DOUBLE_EQ(scale.road(tiles::MapKind::Minor).casing, row.minorCasing) << row.metres;
    }
}

TEST(MapScaleTest, BetweenTwoRows_IsInProportion) {
    EXPECT_DOUBLE_EQ(MapScale(5.0).road(tiles::MapKind::Major).fill, (5.8 + 7.6) / 2.0);
    EXPECT_DOUBLE_EQ(MapScale(1.7).road(tiles::MapKind::Secondary).casing, (9.2 + 15.0) / 2.0);
    EXPECT_DOUBLE_EQ(MapScale(3.1).road(tiles::MapKind::Path).fill, 1.1);
    EXPECT_EQ(MapScale(4.1).road(tiles::MapKind::Path).fill, 0.0);
    EXPECT_EQ(MapScale(5000.0).road(tiles::MapKind::Minor).fill, 0.0);
    EXPECT_GT(MapScale(5000.0).road(tiles::MapKind::Major).fill, 0.0);
}

TEST(MapScaleTest, Names_AppearOneClassAfterTheOther) {
    EXPECT_TRUE(MapScale(25.0).showsNames(tiles::MapKind::WaterName));
    EXPECT_FALSE(MapScale(25.0).showsNames(tiles::MapKind::Major));
    EXPECT_TRUE(MapScale(12.0).showsNames(tiles::MapKind::Major));
    EXPECT_FALSE(MapScale(12.0).showsNames(tiles::MapKind::Secondary));
    EXPECT_TRUE(MapScale(6.0).showsNames(tiles::MapKind::Secondary));
    EXPECT_FALSE(MapScale(6.0).showsNames(tiles::MapKind::Park));
    EXPECT_TRUE(MapScale(4.0).showsNames(tiles::MapKind::ParkName));
    EXPECT_FALSE(MapScale(4.0).showsNames(tiles::MapKind::Minor));
    EXPECT_TRUE(MapScale(2.2).showsNames(tiles::MapKind::Minor));
    EXPECT_FALSE(MapScale(2.2).showsNames(tiles::MapKind::PointOfInterest));
    EXPECT_TRUE(MapScale(1.2).showsNames(tiles::MapKind::PointOfInterest));
    EXPECT_FALSE(MapScale(4.1).showsBuildings());
    EXPECT_TRUE(MapScale(4.0).showsBuildings());
    EXPECT_DOUBLE_EQ(MapScale(2.2).labelFactor(), 1.0);
    EXPECT_DOUBLE_EQ(MapScale(1.2).labelFactor(), 1.2);
    EXPECT_DOUBLE_EQ(MapScale(0.3).labelFactor(), 1.2);
    EXPECT_TRUE(MapScale(3000.0).showsPlace(tiles::PlaceRank::Country));
    EXPECT_FALSE(MapScale(3000.0).showsPlace(tiles::PlaceRank::Village));
    EXPECT_FALSE(MapScale(1.0).showsPlace(tiles::PlaceRank::City));
}

TEST(MapStyleTest, HighContrast_DarkensLettersAndEdgesOnly) {
    for (const bool isDark : {false, true}) {
        const auto& normal = MapStyle::of(isDark, false);
        const auto& high = MapStyle::of(isDark, true);
        EXPECT_EQ(high.land, normal.land);
        EXPECT_EQ(high.water, normal.water);
        const auto away = [&](const QColor& color, const QColor& from) {
            return std::abs(qGray(color.rgb()) - qGray(from.rgb()));
        };
        EXPECT_GT(away(high.label, high.land), away(normal.label, normal.land));
        EXPECT_GT(away(high.waterLabel, high.water), away(normal.waterLabel, normal.water));
        EXPECT_GT(away(high.shore, high.water), away(normal.shore, normal.water));
        EXPECT_GE(away(high.minorCasing, high.minor), away(normal.minorCasing, normal.minor));
    }
}

TEST(MapTilesTest, Tiles_CoverThePictureWithoutGaps) {
    platform::MapPictureRequest request;
    for (const double zoom : {2.0, 13.37, 15.9, 24.0}) {
        for (const double scale : {1.0, 1.5, 2.0, 3.0}) {
            request.viewport = {{53.87, 10.69}, zoom, {400.0, 219.0}};
            request.scale = scale;
            const auto tiles = tilesOf(request, MapTiles::level(request.viewport, 256.0, 0, 14));
            QRegion covered;
            for (const auto& tile : tiles) {
                EXPECT_FALSE(covered.intersects(tile.pixels)) << zoom;
                covered += tile.pixels;
                EXPECT_NEAR(tile.pixels.x() < -100000 ? 0.0 : tile.points.x() * scale - tile.pixels.x(), 0.0, 0.51);
            }
            const QRect picture(0, 0, static_cast<int>(std::lround(400 * scale)),
                                static_cast<int>(std::lround(219 * scale)));
            EXPECT_TRUE(QRegion(picture).subtracted(covered).isEmpty()) << zoom << " at " << scale;
        }
    }
}

TEST(MapTilesTest, Antimeridian_GoesOnWithTheOtherSide) {
    platform::MapPictureRequest request;
    request.viewport = {{0.0, 180.0}, 3.0, {300.0, 100.0}};
    const auto tiles = tilesOf(request, 3);
    ASSERT_EQ(tiles.size(), 4U);
    EXPECT_EQ(tiles[0].key, (tiles::TileKey{3, 7, 3}));
    EXPECT_EQ(tiles[1].key, (tiles::TileKey{3, 0, 3}));
    EXPECT_DOUBLE_EQ(tiles[1].points.x(), 150.0);
    request.viewport.centre.longitude = -180.0;
    EXPECT_EQ(tilesOf(request, 3).front().key, (tiles::TileKey{3, 7, 3}));
}

TEST(MapTilesTest, Poles_HaveNoTilesBeyondTheWorld) {
    platform::MapPictureRequest request;
    request.viewport = {{90.0, 0.0}, 2.0, {100.0, 100.0}};
    for (const auto& tile : tilesOf(request, 2)) {
        EXPECT_EQ(tile.key.y, 0);
        EXPECT_NEAR(tile.points.y(), 50.0, 1e-6);
    }
    request.viewport.centre.latitude = -90.0;
    for (const auto& tile : tilesOf(request, 2)) {
        EXPECT_EQ(tile.key.y, 3);
    }
    EXPECT_FALSE(tilesOf(request, 2).empty());
}

TEST(MapTilesTest, TooManyTiles_AreNone) {
    platform::MapPictureRequest request;
    request.viewport = {{0.0, 0.0}, 2.0, {400.0, 400.0}};
    EXPECT_TRUE(tilesOf(request, 12).empty());
    EXPECT_TRUE(tilesOf(request, -1).empty());
    EXPECT_TRUE(tilesOf(request, 31).empty());
}

TEST(MapTilesTest, Level_MakesTilesOfTheSizeAskedFor) {
    const auto level = [](double zoom) { return MapTiles::level({{}, zoom, {}}, 256.0, 3, 14); };
    EXPECT_EQ(level(0.0), 3);
    EXPECT_EQ(level(8.0), 8);
    EXPECT_EQ(level(8.99), 8);
    EXPECT_EQ(level(22.0), 14);
}

TEST(TileCacheTest, Bytes_AreBounded) {
    TileCache cache(10'000);
    const auto tile = [] {
        auto made = std::make_shared<tiles::MapTile>();
        made->spots.resize(300);
        return made;
    };
    for (int x = 0; x < 50; ++x) {
        cache.put({8, x, 0}, tile());
        cache.find({8, 0, 0});
        EXPECT_LE(cache.bytes(), 10'000U);
    }
    EXPECT_TRUE(cache.find({8, 0, 0}).has_value()) << "used again and again";
    EXPECT_FALSE(cache.find({8, 20, 0}).has_value());
    cache.put({8, 7, 7}, nullptr);
    ASSERT_TRUE(cache.find({8, 7, 7}).has_value());
    EXPECT_EQ(*cache.find({8, 7, 7}), nullptr);
    cache.put({8, 7, 7}, tile());
    EXPECT_NE(*cache.find({8, 7, 7}), nullptr);
    cache.clear();
    EXPECT_EQ(cache.bytes(), 0U);
}

TEST(TileKeyTest, Parent_HoldsTheTile) {
    EXPECT_EQ((tiles::TileKey{14, 8701, 5302}).parent(12), (tiles::TileKey{12, 2175, 1325}));
    EXPECT_EQ((tiles::TileKey{14, 8701, 5302}).parent(14), (tiles::TileKey{14, 8701, 5302}));
    EXPECT_EQ((tiles::TileKey{14, 8701, 5302}).parent(0), (tiles::TileKey{0, 0, 0}));
}

}  // namespace ktr::linux_
