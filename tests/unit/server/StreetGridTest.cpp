#include "server/names/StreetGrid.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

#include "tests/support/maps/TileWriter.h"
#include "tiles/VectorTileDecoder.h"

namespace ktr::server {

using test::LayerWriter;
using test::tileOf;

namespace {

StreetGrid gridOf(const LayerWriter& layer) {
    return StreetGrid(*tiles::VectorTileDecoder("").decode(tileOf({layer})));
}

std::string nameAt(const StreetGrid& grid, double x, double y, double reach = 200.0) {
    const auto found = grid.nearest(x, y, reach);
    return found ? std::string(found->name) : "none";
}

double away(const LayerWriter::Spots& line, double x, double y) {
    double least = 1e9;
    for (std::size_t i = 0; i + 1 < line.size(); ++i) {
        for (int step = 0; step <= 20000; ++step) {
            const double share = step / 20000.0;
            least = std::min(least, std::hypot(line[i].first + share * (line[i + 1].first - line[i].first) - x,
                                               line[i].second + share * (line[i + 1].second - line[i].second) - y));
        }
    }
    return least;
}

}  // namespace

TEST(StreetGridTest, TheNearerOfTwo_IsNamed) {
    const StreetGrid grid = gridOf(LayerWriter("street_labels")
                                       .line({{0, 1000}, {4000, 1000}}, {{"kind", "primary"}, {"name", "Quay Road"}})
                                       .line({{0, 1300}, {4000, 1300}}, {{"kind", "path"}, {"name", "Salt Lane"}}));
    EXPECT_EQ(nameAt(grid, 2000, 1100), "Quay Road");
    EXPECT_EQ(nameAt(grid, 2000, 1200), "Salt Lane");
    EXPECT_EQ(nameAt(grid, 2000, 1501), "none");
    EXPECT_EQ(nameAt(grid, 2000, 1500), "Salt Lane");
}

TEST(StreetGridTest, WhatIsNoStreet_HasNoName) {
    const StreetGrid grid = gridOf(LayerWriter("street_labels")
                                       .line({{0, 1000}, {4000, 1000}}, {{"kind", "rail"}, {"name", "Main Line"}})
                                       .line({{0, 1010}, {4000, 1010}}, {{"kind", "primary"}}));
    EXPECT_EQ(nameAt(grid, 2000, 1005), "none");
}

TEST(StreetGridTest, ASquare_IsNamedByItsEdges) {
    const StreetGrid grid =
        gridOf(LayerWriter("street_polygons")
                   .area({{1000, 1000}, {1400, 1000}, {1400, 1400}, {1000, 1400}}, {{"name", "Fish Market"}}));
    EXPECT_EQ(nameAt(grid, 900, 1200), "Fish Market") << "the edge that closes the ring";
    EXPECT_EQ(nameAt(grid, 1200, 1350), "Fish Market");
}

TEST(StreetGridTest, BesideTheTile_StreetsThatReachThereAreFound) {
    const StreetGrid grid = gridOf(LayerWriter("street_labels")
                                       .line({{4000, 2000}, {4200, 2000}}, {{"kind", "primary"}, {"name", "Quay Road"}})
                                       .line({{-90, -90}, {-10, -10}}, {{"kind", "primary"}, {"name", "Salt Lane"}}));
    EXPECT_EQ(nameAt(grid, 4250, 2010), "Quay Road");
    EXPECT_EQ(nameAt(grid, -95, -80), "Salt Lane");
    EXPECT_EQ(nameAt(grid, 20, 20), "Salt Lane");
}

TEST(StreetGridTest, EverySpot_GetsTheStreetThatIsNearest) {
    std::mt19937 chance(3);
    std::uniform_int_distribution<int> place(-100, 4196);
    std::vector<LayerWriter::Spots> lines;
    LayerWriter layer("street_labels");
    for (int number = 0; number < 12; ++number) {
        lines.push_back({{place(chance), place(chance)}, {place(chance), place(chance)}});
        layer.line(lines.back(), {{"kind", "primary"}, {"name", std::to_string(number)}});
    }
    const StreetGrid grid = gridOf(layer);
    for (int times = 0; times < 60; ++times) {
        const int x = place(chance), y = place(chance);
        double least = 400.0;
        for (const auto& line : lines) {
            least = std::min(least, away(line, x, y));
        }
        const auto found = grid.nearest(x, y, 400.0);
        ASSERT_EQ(found.has_value(), least < 400.0) << x << " " << y;
        if (found) {
            EXPECT_NEAR(found->distance, least, 0.3);
            EXPECT_NEAR(away(lines[static_cast<std::size_t>(std::stoi(std::string(found->name)))], x, y), least, 0.3);
        }
    }
}

TEST(StreetGridTest, ATileFullOfStreets_StaysSmall) {
    // Each as long as the tile and across all of its cells.
    LayerWriter layer("street_labels");
    LayerWriter::Spots zigzag;
    for (int spot = 0; spot < 300'000; ++spot) {
        zigzag.emplace_back(spot % 2 == 0 ? 0 : 4096, spot % 3 == 0 ? 0 : 4096);
    }
    layer.line(zigzag, {{"kind", "primary"}, {"name", "Endless"}});
    const StreetGrid grid = gridOf(layer);
    EXPECT_EQ(nameAt(grid, 2000, 2000, 4000), "Endless");
    EXPECT_LT(grid.bytes(), std::size_t{8} << 20);
}

}  // namespace ktr::server
