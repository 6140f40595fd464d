#include "server/names/PlaceNames.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <fstream>
#include <future>
#include <sstream>

#include "server/names/NameDesk.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/maps/MbtilesWriter.h"
#include "tests/support/maps/TileWriter.h"

namespace ktr::server {

using test::LayerWriter;
using test::MbtilesWriter;
using test::TemporaryFolder;
using test::tileOf;

void PrintTo(const PlaceName& name, std::ostream* out) {
    *out << "{" << name.street << "; " << name.town << "; " << name.words << "}";
}

namespace {

constexpr const char* kTown = KTR_TEST_TOWN "/brinmouth.mbtiles";
const ViewerLocale kEnglish{"en", "DE"};

PlaceNames::Clock::time_point later() {
    return PlaceNames::Clock::now() + std::chrono::hours(1);
}

PlaceName nameIn(PlaceNames& names, const PlaceNames::Place& place, const ViewerLocale& viewer = kEnglish) {
    return names.name(place, viewer, later());
}

struct Truth {
    double latitude = 0.0;
    double longitude = 0.0;
    double metres = 0.0;
    std::string street;
};

std::vector<Truth> plannedStreets() {
    std::ifstream file(KTR_TEST_TOWN "/streets.txt");
    std::vector<Truth> all;
    Truth one;
    while (file >> one.latitude >> one.longitude >> one.metres && std::getline(file >> std::ws, one.street)) {
        all.push_back(one);
    }
    return all;
}

/// A tile of level 14 and one of level 11 about (0, 0), with a street along their northern edge and a town.
void writeEquator(const std::string& path, const std::string& street) {
    MbtilesWriter file(path);
    file.makeTables();
    file.putMetadata("format", "pbf");
    file.putTile(
        {14, 8192, 8192},
        tileOf({LayerWriter("street_labels")
                    .line({{0, 40}, {4096, 40}}, {{"kind", "primary"}, {"name", street}, {"name_de", "Kaistraße"}})}));
    file.putTile({11, 1024, 1024}, tileOf({LayerWriter("place_labels")
                                               .point({{20, 20}}, {{"kind", "village"}, {"name", "Nearby"}})
                                               .point({{900, 900}}, {{"kind", "city"}, {"name", "Large"}})
                                               .point({{21, 21}}, {{"kind", "suburb"}, {"name", "Quarter"}})}));
}

/// Just south-east of (0, 0): in both tiles.
const PlaceNames::Place kEquator{-0.0005, 0.01, true};
/// What is said of it without a map, and without the world's towns.
constexpr const char* kNearEquator = "near Accra, 615\u00a0km";

}  // namespace

TEST(PlaceNamesTest, PointsOfTheDemoTown_GetTheStreetThatItsPlanHas) {
    PlaceNames names({{kTown}});
    const auto points = plannedStreets();
    ASSERT_EQ(points.size(), 1000U);
    int right = 0;
    for (const Truth& point : points) {
        const PlaceName name = nameIn(names, {point.latitude, point.longitude, true});
        right += name.street == point.street ? 1 : 0;
        EXPECT_FALSE(name.words.empty());
    }
    RecordProperty("right", right);
    EXPECT_GE(right, 950);
    EXPECT_LE(names.bytes(), std::size_t{20} << 20);
}

TEST(PlaceNamesTest, WarmLookUps_ReadNothing) {
    PlaceNames names({{kTown}});
    for (int times = 0; times < 2; ++times) {
        const std::uint64_t before = names.tilesRead();
        for (const Truth& point : plannedStreets()) {
            nameIn(names, {point.latitude, point.longitude, true});
        }
        if (times == 1) {
            EXPECT_EQ(names.tilesRead(), before);
        }
    }
    EXPECT_LT(names.tilesRead(), 400U);
}

TEST(PlaceNamesTest, TheTown_IsThatOfTheMap) {
    PlaceNames names({{kTown}});
    const PlaceName name = nameIn(names, {50.211378, -3.115092, true});
    EXPECT_EQ(name.town, "Brinmouth");
    EXPECT_EQ(name.words, name.street + ", Brinmouth");
}

TEST(PlaceNamesTest, BelowExact_StreetsAreNotEvenLookedFor) {
    PlaceNames names({{kTown}});
    const PlaceName name = nameIn(names, {50.211378, -3.115092, false});
    EXPECT_EQ(name, (PlaceName{"", "Brinmouth", ""}));
    EXPECT_EQ(names.streetLookUps(), 0U);
    nameIn(names, {50.211378, -3.115092, true});
    EXPECT_EQ(names.streetLookUps(), 1U);
}

TEST(PlaceNamesTest, AFixThatIsTooCoarseForAStreet_GetsNone) {
    PlaceNames names({{kTown}});
    EXPECT_NE(nameIn(names, {50.211378, -3.115092, true, 200.0}).street, "");
    EXPECT_EQ(nameIn(names, {50.211378, -3.115092, true, 201.0}), (PlaceName{"", "Brinmouth", ""}));
}

TEST(PlaceNamesTest, FarFromTheMap_TheNearestTownIsSaidWithItsDistance) {
    PlaceNames names({{kTown}});
    EXPECT_EQ(nameIn(names, {50.95, -3.90, true}), (PlaceName{"", "", "near Exeter, 38\u00a0km"}));
    EXPECT_EQ(nameIn(names, {48.30, 11.90, true}, {"de", "DE"}).words.find("bei München, "), 0U);
}

TEST(PlaceNamesTest, WithoutTheWorldsTowns_TheNearestBuiltInOneIsSaid) {
    PlaceNames names({{}, {"/nonexistent", "/nonexistent"}});
    EXPECT_EQ(nameIn(names, {50.2104, -3.12, true}), (PlaceName{"", "", "near Guernsey, 94\u00a0km"}));
}

TEST(PlaceNamesTest, EveryPlaceOnEarth_HasAName) {
    PlaceNames names({{kTown}});
    for (const double latitude : {-90.0, -85.06, -85.0, 0.0, 50.21, 85.0, 89.99, 90.0}) {
        for (const double longitude : {-180.0, -179.999, -3.12, 0.0, 179.999, 180.0}) {
            const PlaceName name = nameIn(names, {latitude, longitude, true});
            EXPECT_FALSE(name.words.empty() && name.town.empty()) << latitude << " " << longitude;
        }
    }
}

TEST(PlaceNamesTest, OfSeveralMaps_TheFirstThatKnowsSpeaks) {
    const TemporaryFolder folder;
    const std::string other = (folder.path() / "other.mbtiles").string();
    writeEquator(other, "Equator Road");
    PlaceNames names({{kTown, other}});
    EXPECT_EQ(nameIn(names, kEquator).street, "Equator Road");
    EXPECT_EQ(nameIn(names, {50.211378, -3.115092, true}).town, "Brinmouth");
}

TEST(PlaceNamesTest, Names_AreInTheViewersLanguageWhereTheMapHasThem) {
    const TemporaryFolder folder;
    const std::string map = (folder.path() / "map.mbtiles").string();
    writeEquator(map, "Equator Road");
    PlaceNames names({{map}});
    EXPECT_EQ(nameIn(names, kEquator, {"de", "DE"}).street, "Kaistraße");
    EXPECT_EQ(nameIn(names, kEquator, {"fr", "FR"}).street, "Equator Road");
    EXPECT_EQ(nameIn(names, kEquator, {"de", "DE"}).street, "Kaistraße") << "kept apart";
}

TEST(PlaceNamesTest, TheVillageOneIsIn_GoesBeforeTheCityBeside_AndAQuarterIsNoTown) {
    const TemporaryFolder folder;
    const std::string map = (folder.path() / "map.mbtiles").string();
    writeEquator(map, "Equator Road");
    PlaceNames names({{map}});
    EXPECT_EQ(nameIn(names, kEquator).town, "Nearby");
    EXPECT_EQ(nameIn(names, {-0.03, 0.03, true}).town, "Large");
}

TEST(PlaceNamesTest, BeyondATilesEdge_ItsStreetsAreStillFound) {
    const TemporaryFolder folder;
    const std::string map = (folder.path() / "map.mbtiles").string();
    writeEquator(map, "Equator Road");
    PlaceNames names({{map}});
    // The street lies 24 m south of the equator, this 45 m north of it: in another tile.
    EXPECT_EQ(nameIn(names, {0.0004, 0.01, true}).street, "Equator Road");
    EXPECT_EQ(nameIn(names, {0.0006, 0.01, true}).street, "");
}

TEST(PlaceNamesTest, AMapThatChangesOrGoes_IsSeenToAtOnce) {
    const TemporaryFolder folder;
    const std::filesystem::path map = folder.path() / "map.mbtiles";
    PlaceNames names({{map.string()}, {"/nonexistent", "/nonexistent"}});
    EXPECT_EQ(nameIn(names, kEquator).street, "") << "not there yet";
    writeEquator(map.string(), "Old Road");
    EXPECT_EQ(nameIn(names, kEquator).street, "Old Road");
    writeEquator((folder.path() / "new").string(), "New Road");
    std::filesystem::rename(folder.path() / "new", map);
    EXPECT_EQ(nameIn(names, kEquator).street, "New Road");
    std::filesystem::remove(map);
    EXPECT_EQ(nameIn(names, kEquator).words, kNearEquator);
    EXPECT_EQ(names.complaints().size(), 1U);
}

TEST(PlaceNamesTest, WhatIsNoMap_IsSaidAndPassedOver) {
    const TemporaryFolder folder;
    const std::string pipe = (folder.path() / "pipe").string();
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    const std::string pictures = (folder.path() / "pictures.mbtiles").string();
    {
        MbtilesWriter file(pictures);
        file.makeTables();
        file.putMetadata("format", "png");
    }
    const std::string empty = (folder.path() / "empty.mbtiles").string();
    {
        MbtilesWriter file(empty);
        file.makeTables();
    }
    PlaceNames names({{pipe, pictures, empty, folder.path().string(), folder.write("text", "no map").string(),
                       (folder.path() / "missing").string(), kTown}});
    EXPECT_EQ(names.complaints().size(), 6U);
    EXPECT_EQ(nameIn(names, {50.211378, -3.115092, true}).town, "Brinmouth");
}

TEST(PlaceNamesTest, DamagedTiles_AreTilesWithoutNames) {
    const TemporaryFolder folder;
    const std::string map = (folder.path() / "map.mbtiles").string();
    {
        MbtilesWriter file(map);
        file.makeTables();
        file.putTile({14, 8192, 8192}, "\x1a\xff\xff\xff nonsense");
        file.putTile({11, 1024, 1024}, "\x1f\x8b\x08 not packed");
    }
    PlaceNames names({{map}, {"/nonexistent", "/nonexistent"}});
    EXPECT_EQ(nameIn(names, kEquator).words, kNearEquator);
}

TEST(PlaceNamesTest, AMapThatIsAQuestionWithoutEnd_IsGivenUp) {
    const TemporaryFolder folder;
    const std::string map = (folder.path() / "map.mbtiles").string();
    {
        MbtilesWriter file(map);
        file.run(
            "CREATE TABLE metadata (name TEXT, value TEXT);"
            "INSERT INTO metadata VALUES ('minzoom', '0'), ('maxzoom', '14');"
            "CREATE TABLE n (i INTEGER); INSERT INTO n VALUES (1), (2), (3), (4), (5), (6), (7), (8), (9), (0);"
            "CREATE VIEW tiles AS SELECT a.i AS zoom_level, b.i AS tile_column, c.i AS tile_row, d.i AS tile_data "
            "FROM n a, n b, n c, n d, n e, n f, n g, n h, n j, n k WHERE e.i + f.i + g.i + h.i + j.i + k.i > 90");
    }
    PlaceNames names({{map}, {"/nonexistent", "/nonexistent"}});
    const auto begun = std::chrono::steady_clock::now();
    for (int times = 0; times < 20; ++times) {
        EXPECT_EQ(nameIn(names, kEquator).words, kNearEquator);
    }
    // One question that uses its second of computing up, then none; on a busy machine that takes longer.
    EXPECT_LT(std::chrono::steady_clock::now() - begun, std::chrono::seconds(15));
}

TEST(PlaceNamesTest, WithoutTimeLeft_NoTileIsRead) {
    PlaceNames names({{kTown}});
    const PlaceName name = names.name({50.211378, -3.115092, true}, kEnglish, PlaceNames::Clock::now());
    EXPECT_EQ(name.street, "");
    EXPECT_EQ(name.words.find("near "), 0U);
    EXPECT_EQ(names.tilesRead(), 0U);
    EXPECT_EQ(nameIn(names, {50.211378, -3.115092, true}).town, "Brinmouth") << "not kept as missing";
}

TEST(TileNameCacheTest, TheLatestUsed_AreKeptWithinTheBytes) {
    TileNameCache cache(4000);
    for (int number = 0; number < 100; ++number) {
        cache.put({0, "en", {14, number, 0}}, nullptr);
        EXPECT_TRUE(cache.find({0, "en", {14, 0, 0}})) << "used each time";
        EXPECT_LE(cache.bytes(), 4000U);
    }
    EXPECT_FALSE(cache.find({0, "en", {14, 1, 0}}));
    EXPECT_FALSE(cache.find({0, "de", {14, 99, 0}}));
    EXPECT_FALSE(cache.find({1, "en", {14, 99, 0}}));
    cache.forget(0);
    EXPECT_EQ(cache.bytes(), 0U);
    EXPECT_FALSE(cache.find({0, "en", {14, 99, 0}}));
}

TEST(NameDeskTest, EachWhoAsks_IsToldInTheirOrder) {
    NameDesk desk({{kTown}});
    std::promise<std::vector<PlaceName>> told;
    desk.ask({{50.211378, -3.115092, false}, {50.95, -3.90, true}}, kEnglish,
             [&](std::vector<PlaceName> names) { told.set_value(std::move(names)); });
    const auto names = told.get_future().get();
    ASSERT_EQ(names.size(), 2U);
    EXPECT_EQ(names[0].town, "Brinmouth");
    EXPECT_EQ(names[1].words, "near Exeter, 38\u00a0km");
}

TEST(NameDeskTest, OtherMaps_AreUsedFromTheNextQuestionOn) {
    std::atomic<int> looks = 0;
    NameDesk desk(
        {{}, {}, [&looks] { return ++looks == 2 ? std::optional(std::vector<std::string>{kTown}) : std::nullopt; }});
    const auto townNow = [&desk] {
        std::promise<std::string> told;
        desk.ask({{50.211378, -3.115092, false}}, kEnglish,
                 [&](const std::vector<PlaceName>& names) { told.set_value(names.front().town); });
        return told.get_future().get();
    };
    EXPECT_EQ(townNow(), "");
    EXPECT_EQ(townNow(), "Brinmouth");
    EXPECT_EQ(townNow(), "Brinmouth");
}

TEST(NameDeskTest, WhoComesToADeskThatIsOverrun_IsToldCoordinatesAtOnce) {
    std::promise<void> go, begun;
    std::shared_future<void> gone = go.get_future().share();
    std::atomic<int> told = 0;
    // Its thread uses them until it has ended.
    NameDesk desk({});
    // The first holds the desk up.
    desk.ask({}, kEnglish, [&](const std::vector<PlaceName>&) {
        begun.set_value();
        gone.wait();
    });
    begun.get_future().wait();
    for (std::size_t number = 0; number < NameDesk::kMostWaiting; number += 1000) {
        desk.ask(std::vector<PlaceNames::Place>(1000, {50.21, -3.12, true}), kEnglish,
                 [&](const std::vector<PlaceName>&) { ++told; });
    }
    EXPECT_EQ(told, 0);
    std::vector<PlaceName> late;
    desk.ask({{50.21, -3.12, true}}, kEnglish, [&](std::vector<PlaceName> names) { late = std::move(names); });
    EXPECT_EQ(late, (std::vector<PlaceName>{{"", "", "50.21° north, 3.12° west"}}));
    go.set_value();
}

TEST(NameDeskTest, WhenItEnds_WhoStillWaitsIsLetGo) {
    std::promise<void> go, begun;
    std::shared_future<void> gone = go.get_future().share();
    const auto held = std::make_shared<int>(0);
    std::thread helper;
    {
        NameDesk desk({});
        desk.ask({}, kEnglish, [&](const std::vector<PlaceName>&) {
            begun.set_value();
            gone.wait();
        });
        begun.get_future().wait();
        desk.ask({}, kEnglish, [held](const std::vector<PlaceName>&) { ++*held; });
        helper = std::thread([&] { go.set_value(); });
    }
    helper.join();
    EXPECT_EQ(held.use_count(), 1);
}

}  // namespace ktr::server
