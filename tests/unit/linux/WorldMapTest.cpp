#include "linux/maps/WorldMap.h"

#include <algorithm>
#include <cmath>
#include <fstream>
#include <iterator>

#include "linux/maps/WorldNames.h"
#include "tests/support/PlatformTest.h"

namespace ktr::linux_ {

class WorldMapTest : public test::PlatformTest {
  protected:
    static std::vector<unsigned char> data() {
        std::ifstream stream(KTR_RESOURCES "/maps/world.bin", std::ios::binary);
        return std::vector<unsigned char>(std::istreambuf_iterator<char>(stream), {});
    }
    static const WorldMap::Town& town(const WorldMap& map, const std::string& name) {
        const auto found = std::find_if(map.towns().begin(), map.towns().end(),
                                        [&](const WorldMap::Town& one) { return one.name == name; });
        EXPECT_NE(found, map.towns().end()) << name;
        return *found;
    }
};

TEST_F(WorldMapTest, TheBuiltInMap_IsReadWhole) {
    std::string reason;
    const auto map = WorldMap::read(KTR_RESOURCES "/maps/world.bin", reason);
    ASSERT_NE(map, nullptr) << reason;
    EXPECT_TRUE(reason.empty());
    ASSERT_EQ(map->levels().size(), 3U);
    EXPECT_LT(map->levels()[0].shores.size(), map->levels()[1].shores.size());
    EXPECT_LT(map->levels()[1].shores.size(), map->levels()[2].shores.size());
    EXPECT_GT(map->countries().size(), 230U);
    EXPECT_GT(map->towns().size(), 400U);
}

TEST_F(WorldMapTest, Towns_StandWhereTheyAre) {
    std::string reason;
    const auto map = WorldMap::read(KTR_RESOURCES "/maps/world.bin", reason);
    ASSERT_NE(map, nullptr) << reason;
    const auto& berlin = town(*map, "Berlin");
    EXPECT_NEAR(berlin.place.x(), 13.4 / 360.0 + 0.5, 1e-3);
    EXPECT_NEAR(berlin.place.y(), 0.3280, 1e-3);
    EXPECT_TRUE(berlin.isCapital);
}

TEST_F(WorldMapTest, LevelFor_GivesTheFirstThatIsFineEnough) {
    std::string reason;
    const auto map = WorldMap::read(KTR_RESOURCES "/maps/world.bin", reason);
    ASSERT_NE(map, nullptr) << reason;
    EXPECT_EQ(&map->levelFor(0.0), &map->levels()[0]);
    EXPECT_EQ(&map->levelFor(map->levels()[0].zoom + 0.1), &map->levels()[1]);
    EXPECT_EQ(&map->levelFor(24.0), &map->levels()[2]);
}

TEST_F(WorldMapTest, Stretches_HoldTheirPoints) {
    std::string reason;
    const auto map = WorldMap::read(KTR_RESOURCES "/maps/world.bin", reason);
    ASSERT_NE(map, nullptr) << reason;
    for (const WorldMap::Line& line : map->levels()[1].shores) {
        ASSERT_EQ(line.stretches.size(),
                  (line.points.size() + WorldMap::Line::kStretch - 1) / WorldMap::Line::kStretch);
        for (std::size_t i = 0; i < line.points.size(); ++i) {
            const QRectF& box = line.stretches[i / WorldMap::Line::kStretch];
            ASSERT_TRUE(line.points[i].x() >= box.left() && line.points[i].x() <= box.right() + 1e-12);
            ASSERT_TRUE(line.points[i].y() >= box.top() && line.points[i].y() <= box.bottom() + 1e-12);
        }
    }
}

TEST_F(WorldMapTest, Truncated_IsRefused) {
    const auto whole = data();
    for (const std::size_t size :
         {std::size_t{0}, std::size_t{8}, std::size_t{9}, std::size_t{13}, whole.size() / 2, whole.size() - 1}) {
        std::string reason;
        EXPECT_EQ(WorldMap::parse({whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(size)}, reason), nullptr);
        EXPECT_FALSE(reason.empty()) << size;
    }
}

TEST_F(WorldMapTest, ABombOrAnotherSize_IsRefused) {
    auto large = data();
    std::fill(large.begin() + 9, large.begin() + 13, 0xFF);
    std::string reason;
    EXPECT_EQ(WorldMap::parse(large, reason), nullptr);
    auto small = data();
    small[9] = static_cast<unsigned char>(small[9] ^ 1U);
    EXPECT_EQ(WorldMap::parse(small, reason), nullptr);
}

TEST_F(WorldMapTest, Names_AreInTheLanguage) {
    std::string reason;
    const auto map = WorldMap::read(KTR_RESOURCES "/maps/world.bin", reason);
    ASSERT_NE(map, nullptr) << reason;
    WorldMap::Country germany;
    germany.number = 276;
    germany.name = "Germany";
    EXPECT_EQ(WorldNames("de-AT").country(germany), "Deutschland");
    EXPECT_EQ(WorldNames("ja").country(germany), "ドイツ");
    EXPECT_EQ(WorldNames("").country(germany), "Germany");
    EXPECT_EQ(WorldNames("no such language").country(germany), "Germany");
    EXPECT_EQ(WorldNames("ja").town(town(*map, "Tokyo")), "東京");
    EXPECT_EQ(WorldNames("en-GB").town(town(*map, "Tokyo")), "Tokyo");
    WorldMap::Country none;
    none.name = "Somaliland";
    EXPECT_EQ(WorldNames("de").country(none), "Somaliland");
    none.number = 998;
    EXPECT_EQ(WorldNames("de").country(none), "Somaliland");
}

}  // namespace ktr::linux_
