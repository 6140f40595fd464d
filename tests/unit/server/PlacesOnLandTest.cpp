// 1,000 places on land in every language of the page, with KTR_LONG_TESTS=1; else a few. The nearest town is found here
// another way: by the length of the geodesic to every town of the file, which is read by a plain search.
#include <gtest/gtest.h>

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <limits>
#include <sstream>

#include "server/names/PlaceNames.h"
#include "server/names/WorldTowns.h"
#include "server/page/PageTexts.h"

namespace ktr::server {

namespace {

struct Town {
    std::string name;
    double latitude;
    double longitude;
};
struct Near {
    const Town* town = nullptr;
    double metres = std::numeric_limits<double>::infinity();
};

std::vector<std::pair<double, double>> placesOnLand() {
    std::vector<std::pair<double, double>> places;
    std::ifstream file(KTR_TEST_DATA "/unit/server/places/on-land.txt");
    for (double latitude = 0.0, longitude = 0.0; file >> latitude >> longitude;) {
        places.emplace_back(latitude, longitude);
    }
    return places;
}

std::vector<Town> installedTowns() {
    std::stringstream text;
    text << std::ifstream(Gazetteer::Files().towns).rdbuf();
    const std::string all = text.str();
    // A town's own name and place stand before those of its weather stations.
    std::vector<Town> towns;
    for (std::size_t at = all.find("<city>"); at != std::string::npos; at = all.find("<city>", at + 1)) {
        const std::size_t name = all.find('>', std::min(all.find("<_name", at), all.find("<name", at))) + 1;
        const std::size_t place = all.find("<coordinates>", at) + 13;
        std::istringstream degrees(all.substr(place, 40));
        Town town{all.substr(name, all.find('<', name) - name), 0.0, 0.0};
        degrees >> town.latitude >> town.longitude;
        // One has a longitude of -565 degrees.
        if (std::abs(town.latitude) <= 90.0 && std::abs(town.longitude) <= 180.0) {
            towns.push_back(std::move(town));
        }
    }
    return towns;
}

Near nearest(const std::vector<Town>& towns, double latitude, double longitude) {
    Near near;
    for (const Town& town : towns) {
        double metres = 0.0;
        GeographicLib::Geodesic::WGS84().Inverse(latitude, longitude, town.latitude, town.longitude, metres);
        near = metres < near.metres ? Near{&town, metres} : near;
    }
    return near;
}

std::size_t some(std::size_t all, std::size_t few) {
    return std::getenv("KTR_LONG_TESTS") != nullptr ? all : few;
}

}  // namespace

TEST(PlacesOnLandTest, InEveryLanguage_TheNearestTownIsNamedWithItsDistance) {
    const auto places = placesOnLand();
    const auto towns = installedTowns();
    ASSERT_EQ(places.size(), 1000U);
    ASSERT_GT(towns.size(), 4000U);
    Gazetteer gazetteer{Gazetteer::Files()};
    ASSERT_EQ(towns.size(), gazetteer.count());
    PlaceNames names({});
    ASSERT_EQ(PageTexts::languages().size(), 21U);
    for (std::size_t number = 0; number < some(places.size(), 40); ++number) {
        const auto [latitude, longitude] = places[number];
        const Near near = nearest(towns, latitude, longitude);
        const auto found = gazetteer.nearest(latitude, longitude);
        ASSERT_EQ(found.town->name, near.town->name) << latitude << " " << longitude;
        EXPECT_NEAR(found.metres, near.metres, 0.001);
        for (const auto language : PageTexts::languages()) {
            const ViewerLocale viewer{std::string(language), ""};
            const PlaceName name =
                names.name({latitude, longitude, true}, viewer, PlaceNames::Clock::time_point::max());
            EXPECT_EQ(name.words, PlaceWords(viewer).near(gazetteer.name(*found.town, viewer.language), near.metres))
                << language;
            EXPECT_EQ(name.street + name.town, "");
        }
    }
}

TEST(PlacesOnLandTest, WithoutTheWorldsTowns_TheBuiltInOnesAreNamed) {
    std::vector<Town> towns;
    for (const WorldTowns::Town& town : WorldTowns::all()) {
        towns.push_back({town.name, town.latitude, town.longitude});
    }
    EXPECT_GT(towns.size(), 400U);
    Gazetteer gazetteer({"/nonexistent", "/nonexistent"});
    const auto places = placesOnLand();
    for (std::size_t number = 0; number < some(places.size(), 200); ++number) {
        const auto [latitude, longitude] = places[number];
        const Near near = nearest(towns, latitude, longitude);
        EXPECT_EQ(gazetteer.nearest(latitude, longitude).town->name, near.town->name) << latitude << " " << longitude;
        EXPECT_NEAR(gazetteer.nearest(latitude, longitude).metres, near.metres, 0.001);
    }
}

TEST(PlacesOnLandTest, AWarmLookUp_ReadsNothing) {
    PlaceNames names({{KTR_TEST_TOWN "/brinmouth.mbtiles"}});
    const auto walk = [&] {
        for (const auto& [latitude, longitude] : placesOnLand()) {
            names.name({latitude, longitude, true}, {"de", "DE"}, PlaceNames::Clock::time_point::max());
            names.name({50.205 + 0.01 * std::abs(std::sin(latitude)), -3.12 + 0.01 * std::sin(longitude), true},
                       {"de", "DE"}, PlaceNames::Clock::time_point::max());
        }
    };
    walk();
    const auto tiles = names.tilesRead();
    const auto bytes = names.bytes();
    EXPECT_GT(tiles, 0U);
    walk();
    EXPECT_EQ(names.tilesRead(), tiles);
    EXPECT_EQ(names.bytes(), bytes);
    EXPECT_LT(bytes, std::size_t{20} << 20);
}

}  // namespace ktr::server
