#include "tiles/VectorTileDecoder.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "tests/support/maps/TileWriter.h"

namespace ktr::tiles {

using test::LayerWriter;
using test::tileOf;

namespace {

const MapTile::Feature* featureOf(const MapTile& tile, MapKind kind) {
    const auto found = std::find_if(tile.features.begin(), tile.features.end(),
                                    [&](const MapTile::Feature& feature) { return feature.kind == kind; });
    return found == tile.features.end() ? nullptr : &*found;
}

std::string nameOf(const MapTile& tile, MapKind kind) {
    const auto* feature = featureOf(tile, kind);
    return !feature            ? "no feature"
           : feature->name < 0 ? "no name"
                               : tile.names[static_cast<std::size_t>(feature->name)];
}

std::shared_ptr<const MapTile> decode(const std::vector<LayerWriter>& layers, const std::string& language = "") {
    return VectorTileDecoder(language).decode(tileOf(layers));
}

const LayerWriter::Spots kLine = {{0, 0}, {100, 50}, {200, 50}};
const LayerWriter::Spots kRing = {{10, 10}, {90, 10}, {90, 60}, {10, 60}};

/// A tile with some of everything.
std::string town() {
    return tileOf({LayerWriter("streets")
                       .line(kLine, {{"kind", "primary"}, {"name", "Quay Road"}})
                       .line(kLine, {{"kind", "rail"}}),
                   LayerWriter("land").area(kRing, {{"kind", "park"}, {"name", "Lantern Park"}}),
                   LayerWriter("water_polygons").area(kRing, {{"kind", "river"}}),
                   LayerWriter("place_labels").point({{5, 5}}, {{"kind", "town"}, {"name", "Elmstead"}})});
}

}  // namespace

TEST(VectorTileDecoderTest, Geometry_IsRead) {
    const auto tile =
        decode({LayerWriter("streets").add(2, {kLine, {{300, 300}, {290, 310}}}, {{"kind", "residential"}}),
                LayerWriter("buildings").area(kRing, {})});
    ASSERT_NE(tile, nullptr);
    const auto* street = featureOf(*tile, MapKind::Minor);
    ASSERT_NE(street, nullptr);
    EXPECT_EQ(street->shape, MapTile::Shape::Lines);
    ASSERT_EQ(street->partCount, 2U);
    EXPECT_EQ(tile->partEnds[street->firstPart] - tile->partBegin(street->firstPart), 3U);
    EXPECT_EQ(tile->spots[tile->partBegin(street->firstPart) + 1], (MapTile::Spot{100.0F, 50.0F}));
    EXPECT_EQ(tile->spots[tile->partBegin(street->firstPart + 1)], (MapTile::Spot{300.0F, 300.0F}));
    EXPECT_EQ(street->right, 300.0F);
    EXPECT_EQ(street->top, 0.0F);
    const auto* building = featureOf(*tile, MapKind::Building);
    ASSERT_NE(building, nullptr);
    EXPECT_EQ(tile->partEnds[building->firstPart] - tile->partBegin(building->firstPart), 4U);
    EXPECT_TRUE(std::is_sorted(tile->features.begin(), tile->features.end(),
                               [](const auto& a, const auto& b) { return a.kind < b.kind; }));
}

TEST(VectorTileDecoderTest, OtherExtent_IsScaled) {
    const auto tile = decode({LayerWriter("streets", 512).line(kLine, {{"kind", "residential"}})});
    ASSERT_NE(tile, nullptr);
    ASSERT_EQ(tile->features.size(), 1U);
    EXPECT_EQ(tile->spots[1], (MapTile::Spot{800.0F, 400.0F}));
    for (const std::uint32_t extent : {0U, 0x80000000U}) {
        EXPECT_TRUE(decode({LayerWriter("streets", extent).line(kLine, {{"kind", "residential"}})})->features.empty());
    }
}

TEST(VectorTileDecoderTest, Shortbread_IsUnderstood) {
    const auto tile = decode({LayerWriter("ocean").area(kRing, {}),
                              LayerWriter("streets")
                                  .line(kLine, {{"kind", "motorway"}})
                                  .line(kLine, {{"kind", "tertiary"}})
                                  .line(kLine, {{"kind", "living_street"}})
                                  .line(kLine, {{"kind", "service"}})
                                  .line(kLine, {{"kind", "steps"}})
                                  .line(kLine, {{"kind", "rail"}})
                                  .line(kLine, {{"kind", "subway"}})
                                  .line(kLine, {{"kind", "taxiway"}}),
                              LayerWriter("boundaries")
                                  .line(kLine, {{"admin_level", "#2"}})
                                  .line(kLine, {{"admin_level", "#2"}, {"maritime", "#1"}})
                                  .line(kLine, {{"admin_level", "#9"}}),
                              LayerWriter("pier_lines").line(kLine, {{"kind", "pier"}}),
                              LayerWriter("water_lines").line(kLine, {{"kind", "canal"}, {"name", "Cut"}}),
                              LayerWriter("addresses").point({{1, 1}}, {{"housenumber", "7"}}),
                              LayerWriter("pois").point({{1, 1}}, {{"amenity", "bench"}, {"name", "Bench"}}),
                              LayerWriter("no such layer").line(kLine, {{"kind", "motorway"}})});
    ASSERT_NE(tile, nullptr);
    std::vector<MapKind> kinds;
    for (const auto& feature : tile->features) {
        kinds.push_back(feature.kind);
    }
    EXPECT_EQ(kinds, (std::vector<MapKind>{MapKind::Water, MapKind::WaterLine, MapKind::PierLine, MapKind::Path,
                                           MapKind::Service, MapKind::Minor, MapKind::Secondary, MapKind::Major,
                                           MapKind::Rail, MapKind::Boundary}));
    EXPECT_EQ(featureOf(*tile, MapKind::WaterLine)->rank, 8);
    EXPECT_EQ(featureOf(*tile, MapKind::Boundary)->rank, 2);
}

TEST(VectorTileDecoderTest, OpenMapTiles_IsDetected) {
    const auto tile =
        decode({LayerWriter("water").area(kRing, {{"class", "lake"}}),
                LayerWriter("waterway").line(kLine, {{"class", "river"}, {"name", "Ilm"}}),
                LayerWriter("landcover").area(kRing, {{"class", "grass"}, {"subclass", "park"}}),
                LayerWriter("landuse").area(kRing, {{"class", "residential"}}), LayerWriter("building").area(kRing, {}),
                LayerWriter("transportation")
                    .line(kLine, {{"class", "primary"}})
                    .line(kLine, {{"class", "minor"}})
                    .line(kLine, {{"class", "rail"}})
                    .line(kLine, {{"class", "rail"}, {"brunnel", "tunnel"}})
                    .line(kLine, {{"class", "path"}, {"subclass", "footway"}}),
                LayerWriter("transportation_name").line(kLine, {{"class", "secondary"}, {"name", "High Street"}}),
                LayerWriter("water_name").point({{9, 9}}, {{"class", "lake"}, {"name", "Mere"}}),
                LayerWriter("place").point({{9, 9}}, {{"class", "city"}, {"capital", "#2"}, {"name", "Main"}}),
                LayerWriter("boundary").line(kLine, {{"admin_level", "#4"}})});
    ASSERT_NE(tile, nullptr);
    for (const auto kind : {MapKind::Water, MapKind::WaterLine, MapKind::Park, MapKind::BuiltUp, MapKind::Building,
                            MapKind::Major, MapKind::Minor, MapKind::Path, MapKind::Boundary}) {
        EXPECT_NE(featureOf(*tile, kind), nullptr) << static_cast<int>(kind);
    }
    EXPECT_EQ(std::count_if(tile->features.begin(), tile->features.end(),
                            [](const auto& feature) { return feature.kind == MapKind::Rail; }),
              1);
    EXPECT_EQ(nameOf(*tile, MapKind::Secondary), "High Street");
    EXPECT_EQ(nameOf(*tile, MapKind::WaterName), "Mere");
    EXPECT_EQ(featureOf(*tile, MapKind::Place)->rank, static_cast<int>(PlaceRank::Capital));
}

TEST(VectorTileDecoderTest, Protomaps_IsDetected) {
    const auto tile = decode(
        {LayerWriter("earth").area(kRing, {{"kind", "earth"}}),
         LayerWriter("water").area(kRing, {{"kind", "ocean"}}).point({{1, 1}}, {{"kind", "sea"}, {"name", "Sound"}}),
         LayerWriter("landuse").area(kRing, {{"kind", "park"}}).area(kRing, {{"pmap:kind", "pedestrian"}}),
         LayerWriter("buildings").area(kRing, {{"kind", "building"}}),
         LayerWriter("roads")
             .line(kLine, {{"kind", "major_road"}, {"kind_detail", "tertiary"}})
             .line(kLine, {{"kind", "highway"}})
             .line(kLine, {{"kind", "minor_road"}, {"name", "Lane"}})
             .line(kLine, {{"kind", "rail"}, {"kind_detail", "tram"}}),
         LayerWriter("boundaries").line(kLine, {{"kind", "country"}}),
         LayerWriter("places").point({{1, 1}}, {{"kind", "locality"}, {"kind_detail", "village"}, {"name", "Hill"}})});
    ASSERT_NE(tile, nullptr);
    for (const auto kind : {MapKind::Water, MapKind::Park, MapKind::Square, MapKind::Building, MapKind::Secondary,
                            MapKind::Major, MapKind::Boundary, MapKind::WaterName}) {
        EXPECT_NE(featureOf(*tile, kind), nullptr) << static_cast<int>(kind);
    }
    EXPECT_EQ(featureOf(*tile, MapKind::Rail), nullptr);
    EXPECT_EQ(nameOf(*tile, MapKind::Minor), "Lane");
    EXPECT_EQ(featureOf(*tile, MapKind::Place)->rank, static_cast<int>(PlaceRank::Village));
}

TEST(VectorTileDecoderTest, Name_IsInTheLanguageAskedFor) {
    const auto named = [](const std::string& language) {
        const auto tile = decode({LayerWriter("place_labels")
                                      .point({{1, 1}}, {{"kind", "city"},
                                                        {"name", "Wien"},
                                                        {"name:en", "Vienna"},
                                                        {"name_hu", "Bécs"},
                                                        {"name:zh-Hant", "維也納"},
                                                        {"name:zh", "维也纳"},
                                                        {"name:it", ""}})},
                                 language);
        return nameOf(*tile, MapKind::Place);
    };
    EXPECT_EQ(named(""), "Wien");
    EXPECT_EQ(named("en"), "Vienna");
    EXPECT_EQ(named("en-GB"), "Vienna");
    EXPECT_EQ(named("hu"), "Bécs");
    EXPECT_EQ(named("zh-Hant-TW"), "維也納");
    EXPECT_EQ(named("zh-CN"), "维也纳");
    EXPECT_EQ(named("it"), "Wien");
    EXPECT_EQ(named("ar"), "Wien");
}

TEST(VectorTileDecoderTest, TilesMadeForOneLanguage_HaveNamesToo) {
    const auto named = [](const LayerWriter::Tags& names, const std::string& language) {
        LayerWriter::Tags tags = {{"class", "city"}};
        tags.insert(tags.end(), names.begin(), names.end());
        return nameOf(*decode({LayerWriter("place").point({{1, 1}}, tags), LayerWriter("transportation")}, language),
                      MapKind::Place);
    };
    EXPECT_EQ(named({{"name:latin", "Wien"}}, "en"), "Wien");
    EXPECT_EQ(named({{"name:latin", "Vienna"}, {"name_int", "Wien"}}, "en"), "Vienna");
    EXPECT_EQ(named({{"name_int", "Wien"}}, "en"), "Wien");
    EXPECT_EQ(named({{"name:latin", "Wien"}, {"name:hu", "Bécs"}}, "hu"), "Bécs");
    EXPECT_EQ(named({{"name", "Київ"}, {"name:latin", "Kyiv"}}, "uk"), "Київ");
}

TEST(VectorTileDecoderTest, NameBeyondItsCap_OrNoUtf8_IsNone) {
    const auto named = [](const std::string& name) {
        return nameOf(*decode({LayerWriter("streets").line(kLine, {{"kind", "residential"}, {"name", name}})}),
                      MapKind::Minor);
    };
    EXPECT_EQ(named(std::string(160, 'a')), std::string(160, 'a'));
    EXPECT_EQ(named(std::string(161, 'a')), "no name");
    EXPECT_EQ(named("\xC3\x28"), "no name");
    EXPECT_EQ(named(""), "no name");
}

TEST(VectorTileDecoderTest, WrongGeometry_LeavesOutThatFeatureAlone) {
    const LayerWriter::Tags tags = {{"kind", "residential"}};
    const std::vector<std::vector<std::uint32_t>> wrong = {
        {},                                             // none
        {9, 2},                                         // half a point
        {9, 2, 2, 0xFFFFFFFAU, 2, 2},                   // more lines than there are
        {9, 2, 2},                                      // one point
        {11, 2, 2, 10, 4, 4},                           // no such command
        {15},                                           // closes nothing
        {9, 0x7FFFFFFEU, 2, 18, 0x7FFFFFFEU, 2, 2, 2},  // far away
        {0xFFFFFFF9U},                                  // half a thousand million moves
    };
    for (const auto& commands : wrong) {
        const auto tile = VectorTileDecoder("").decode(tileOf({LayerWriter("streets")
                                                                   .raw(2, commands, tags)
                                                                   .line(kLine, {{"kind", "primary"}})
                                                                   .raw(0, {9, 2, 2}, tags)
                                                                   .raw(9, {9, 2, 2}, tags)}));
        ASSERT_NE(tile, nullptr);
        ASSERT_EQ(tile->features.size(), 1U) << commands.size();
        EXPECT_EQ(tile->features[0].kind, MapKind::Major);
        EXPECT_EQ(tile->spots.size(), kLine.size());
        EXPECT_EQ(tile->partEnds.size(), 1U);
    }
}

TEST(VectorTileDecoderTest, Truncated_IsDamagedOrWhole) {
    const std::string whole = town();
    for (std::size_t size = 0; size < whole.size(); ++size) {
        const auto tile = VectorTileDecoder("en").decode(std::string_view(whole).substr(0, size));
        if (tile) {
            EXPECT_LE(tile->features.size(), 5U);
        }
    }
    EXPECT_EQ(VectorTileDecoder("en").decode(whole)->features.size(), 5U);
    EXPECT_EQ(VectorTileDecoder("en").decode(std::string_view(whole).substr(0, whole.size() - 1)), nullptr);
    EXPECT_TRUE(VectorTileDecoder("en").decode("")->features.empty());
}

TEST(VectorTileDecoderTest, Scribbled_NeverCrashes) {
    const std::string whole = town();
    std::uint32_t random = 99;
    const auto next = [&] { return (random = random * 1664525U + 1013904223U) >> 8U; };
    for (int round = 0; round < 5000; ++round) {
        std::string damaged = whole;
        for (int scribble = 0; scribble < 4; ++scribble) {
            damaged[next() % damaged.size()] = static_cast<char>(next());
        }
        const auto tile = VectorTileDecoder("en").decode(damaged);
        if (!tile) {
            continue;
        }
        for (const auto& feature : tile->features) {
            ASSERT_LE(feature.firstPart + feature.partCount, tile->partEnds.size());
            ASSERT_LT(feature.name, static_cast<std::int32_t>(tile->names.size()));
            ASSERT_GT(feature.partCount, 0U);
        }
    }
}

TEST(VectorTileDecoderTest, AttributesBeyondTheTables_AreLeftOut) {
    std::string feature;
    protozero::pbf_writer writer(feature);
    const std::vector<std::uint32_t> tags = {0, 0, 7, 0, 0, 9, 0};
    const std::vector<std::uint32_t> geometry = {9, 2, 2, 10, 4, 4};
    writer.add_packed_uint32(2, tags.begin(), tags.end());
    writer.add_enum(3, 2);
    writer.add_packed_uint32(4, geometry.begin(), geometry.end());
    std::string layer;
    protozero::pbf_writer layerWriter(layer);
    layerWriter.add_string(1, "streets");
    layerWriter.add_message(2, feature);
    layerWriter.add_string(3, "kind");
    layerWriter.add_message(4, std::string("\x0A\x07primary", 9));
    std::string tile;
    protozero::pbf_writer(tile).add_message(3, layer);
    const auto decoded = VectorTileDecoder("").decode(tile);
    ASSERT_NE(decoded, nullptr);
    ASSERT_EQ(decoded->features.size(), 1U);
    EXPECT_EQ(decoded->features[0].kind, MapKind::Major);
}

TEST(VectorTileDecoderTest, TooMuch_IsCutAtTheCap) {
    LayerWriter crowded("streets");
    LayerWriter::Spots zigzag;
    for (int index = 0; index < 30'000; ++index) {
        zigzag.emplace_back(index % 4096, index / 16);
    }
    for (int count = 0; count < 40; ++count) {
        crowded.line(zigzag, {{"kind", "residential"}});
    }
    const auto tile = decode({crowded});
    ASSERT_NE(tile, nullptr);
    EXPECT_LE(tile->spots.size(), VectorTileDecoder::kMostSpots);
    EXPECT_GT(tile->spots.size(), VectorTileDecoder::kMostSpots - 30'001);
    EXPECT_LT(tile->bytes(), std::size_t{12} << 20);
}

}  // namespace ktr::tiles
