#include "views/MapSentences.h"

#include <limits>

#include "tests/support/MapTest.h"

namespace ktr {

using namespace platform;
using test::fenceOf;
using test::friendByEmail;
using test::placed;

class MapSentencesTest : public test::MapTest {
  protected:
    MapSentencesTest() {
        set("ACCESSIBILITY_MAP_FRIEND_AT", "Map: %1$@, at %2$@");
        set("ACCESSIBILITY_MAP_FRIEND", "Map: %@");
        set("ACCESSIBILITY_MAP_UNKNOWN", "Map: no place known for %@");
        set("ACCESSIBILITY_MAP_ACCURACY", "Accurate to %@");
        set("ACCESSIBILITY_MAP_FENCE_AT", "Map: the area around %@");
        set("ACCESSIBILITY_MAP_FENCE", "Map: the area");
        set("ACCESSIBILITY_MAP_RADIUS", "Radius: %@");
        set("ACCESSIBILITY_MAP_YOU", "Map: you are here");
        set("ACCESSIBILITY_MAP_YOU_UNKNOWN", "Map: where you are is not known yet");
        set("ACCESSIBILITY_MAP_SENTENCES", "%1$@. %2$@");
        set("ACCESSIBILITY_MAP_SAME_PLACE", "In the same place as you");
        for (const char* way : {"NORTH", "NORTHEAST", "EAST", "SOUTHEAST", "SOUTH", "SOUTHWEST", "WEST", "NORTHWEST"}) {
            set(std::string("ACCESSIBILITY_MAP_") + way, std::string("%@ ") + way);
        }
        set("_$!<home>!$_", "Home");
        user->position = position(51.0, -1.01);
    }
    void set(const std::string& key, const std::string& text) { localization->set("org.ktr.snippets", key, text); }
    std::string ofFriend(const std::shared_ptr<VAKtrLocation>& object) {
        return MapSentences::ofFriend(*record(object), user->position);
    }
};

TEST_F(MapSentencesTest, Friend_WhereHowSureHowFarAndInWhichDirection) {
    EXPECT_EQ(ofFriend(ann()), "Map: Ann, at Springfield. Accurate to 10 metres. 700 m EAST");
}

TEST_F(MapSentencesTest, Direction_IsTheNearestOfEight) {
    user->position = position(51.0, -1.0);
    const std::vector<std::pair<Coordinate, std::string>> places = {
        {{51.01, -1.0}, "NORTH"},      {{51.01, -0.99}, "NORTHEAST"}, {{51.0, -0.99}, "EAST"},
        {{50.99, -0.99}, "SOUTHEAST"}, {{50.99, -1.0}, "SOUTH"},      {{50.99, -1.01}, "SOUTHWEST"},
        {{51.0, -1.01}, "WEST"},       {{51.01, -1.01}, "NORTHWEST"}, {{51.01, -1.0001}, "NORTH"}};
    for (const auto& [place, way] : places) {
        const auto text = ofFriend(placed(ann(), place.latitude, place.longitude));
        EXPECT_EQ(text.substr(text.rfind(' ') + 1), way);
    }
}

TEST_F(MapSentencesTest, SamePlace_HasNoDirection) {
    user->position = position(51.0, -1.0);
    EXPECT_EQ(ofFriend(placed(ann(), 51.0, -1.0)), "Map: Ann. Accurate to 10 metres. In the same place as you");
}

TEST_F(MapSentencesTest, UserUnknown_NoDistance) {
    user->position = nullptr;
    EXPECT_EQ(ofFriend(ann()), "Map: Ann, at Springfield. Accurate to 10 metres");
}

TEST_F(MapSentencesTest, AccuracyMissingOrNone_IsNotTold) {
    user->position = nullptr;
    for (const std::optional<double> accuracy : {std::optional<double>{}, std::optional(0.0), std::optional(-1.0)}) {
        auto object = ann();
        object->accuracy = accuracy;
        EXPECT_EQ(ofFriend(object), "Map: Ann, at Springfield");
    }
}

TEST_F(MapSentencesTest, DefaultLabel_IsTranslated) {
    user->position = nullptr;
    auto object = ann();
    object->label = "_$!<home>!$_";
    EXPECT_EQ(ofFriend(object), "Map: Ann, at Home. Accurate to 10 metres");
}

TEST_F(MapSentencesTest, NoPlaceAndNullIsland_AreUnknown) {
    EXPECT_EQ(ofFriend(friendByEmail("Ann", "ann@example.org")), "Map: no place known for Ann");
    EXPECT_EQ(ofFriend(placed(ann(), 0.0, 0.0)), "Map: no place known for Ann");
}

TEST_F(MapSentencesTest, Fence_PlaceRadiusAndDistance) {
    const auto fence = fenceOf(friendByEmail("Ann", "ann@example.org")->friend_, std::nullopt, "_$!<home>!$_");
    EXPECT_EQ(MapSentences::ofFence(*fence, user->position),
              "Map: the area around Home. Radius: 100 metres. 700 m EAST");
    const auto nameless = fenceOf(nullptr, std::nullopt);
    EXPECT_EQ(MapSentences::ofFence(*nameless, nullptr), "Map: the area. Radius: 100 metres");
    nameless->location = nullptr;
    EXPECT_EQ(MapSentences::ofFence(*nameless, user->position), "Map: the area");
}

TEST_F(MapSentencesTest, Fence_DefaultLabelInAnyLetters_IsNamedAsInTheRow) {
    for (const char* label : {"_$!<Home>!$_", "_$!<HOME>!$_"}) {
        const auto fence = fenceOf(nullptr, std::nullopt, label);
        EXPECT_EQ(MapSentences::ofFence(*fence, nullptr), "Map: the area around Home. Radius: 100 metres") << label;
    }
}

TEST_F(MapSentencesTest, LengthsBeyondTheEarth_AreNotTold) {
    user->position = nullptr;
    for (const double metres : {2.02e7, 1e300, std::numeric_limits<double>::infinity()}) {
        const auto fence = fenceOf(nullptr, std::nullopt);
        fence->location->accuracy = metres;
        EXPECT_EQ(MapSentences::ofFence(*fence, nullptr), "Map: the area");
        auto object = ann();
        object->accuracy = metres;
        EXPECT_EQ(ofFriend(object), "Map: Ann, at Springfield");
        EXPECT_EQ(MapSentences::ofUser(position(51.0, -1.0, metres)), "Map: you are here");
    }
    const auto fence = fenceOf(nullptr, std::nullopt);
    fence->location->accuracy = 5000.0;
    EXPECT_EQ(MapSentences::ofFence(*fence, nullptr), "Map: the area. Radius: 5 kilometres");
}

TEST_F(MapSentencesTest, User_WithAccuracyOrUnknown) {
    EXPECT_EQ(MapSentences::ofUser(position(51.0, -1.0, 15.0)), "Map: you are here. Accurate to 15 metres");
    EXPECT_EQ(MapSentences::ofUser(nullptr), "Map: where you are is not known yet");
}

// On the map

TEST_F(MapSentencesTest, Map_TellsOfWhatItShows) {
    const auto map = makeMap();
    EXPECT_EQ(map->accessibilityText(), "");
    map->setLocation(record(ann()));
    EXPECT_EQ(map->accessibilityText(), "Map: Ann, at Springfield. Accurate to 10 metres. 700 m EAST");
    user->position = nullptr;
    EXPECT_EQ(map->accessibilityText(), "Map: Ann, at Springfield. Accurate to 10 metres");
    map->setAccessibilityLabel("Another");
    EXPECT_EQ(map->accessibilityText(), "Another");
}

TEST_F(MapSentencesTest, VisibilityMap_TellsOfTheUser) {
    locationManagers->cached = position(50.0, -1.0, 20.0);
    user->position = nullptr;
    const auto map = makeMap();
    map->setIsVisibilityMap(true);
    EXPECT_EQ(map->accessibilityText(), "Map: you are here. Accurate to 20 metres");
}

TEST_F(MapSentencesTest, FenceMap_KnowsTheUserFromTheMap) {
    locationManagers->cached = position(51.0, -1.01);
    const auto map = makeMap();
    map->setCurrentLocationDelegate({});
    map->setGeoFence(fenceOf(nullptr, std::nullopt, "Yard"));
    EXPECT_EQ(map->accessibilityText(), "Map: the area around Yard. Radius: 100 metres. 700 m EAST");
}

}  // namespace ktr
