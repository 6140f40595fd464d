#include "linux/maps/MainlandArea.h"

#include <gtest/gtest.h>

#include <cmath>

namespace ktr::linux_ {

namespace {

using platform::Coordinate;

struct Place {
    const char* name;
    Coordinate coordinate;
};

const MainlandArea& area() {
    static const MainlandArea made = [] {
        std::string reason;
        const auto map = WorldMap::read(KTR_RESOURCES "/maps/world.bin", reason);
        EXPECT_NE(map, nullptr) << reason;
        return MainlandArea(map ? map->outline() : WorldMap::Outline());
    }();
    return made;
}

constexpr Place kInside[] = {
    {"Beijing", {39.9042, 116.4074}},   {"Pingxiang", {22.0945, 106.7665}}, {"Longzhou", {22.3423, 106.8540}},
    {"Ningming", {22.1400, 107.0760}},  {"Yadong", {27.4841, 88.9072}},     {"Fuyuan", {48.3647, 134.3080}},
    {"Dongxing", {21.5477, 107.9719}},  {"Ruili", {24.0127, 97.8517}},      {"Wanding", {24.0833, 98.0667}},
    {"Hekou", {22.5293, 103.9394}},     {"Dandong", {40.1290, 124.3947}},   {"Manzhouli", {49.5980, 117.3790}},
    {"Heihe", {50.2450, 127.5280}},     {"Suifenhe", {44.3960, 131.1500}},  {"Hunchun", {42.8625, 130.3660}},
    {"Tumen", {42.9680, 129.8420}},     {"Linjiang", {41.8110, 126.9180}},  {"Ji'an", {41.1260, 126.1900}},
    {"Changbai", {41.4200, 128.2000}},  {"Erenhot", {43.6530, 111.9770}},   {"Khorgos", {44.2120, 80.4200}},
    {"Alashankou", {45.1700, 82.5700}}, {"Tacheng", {46.7450, 82.9800}},    {"Jeminay", {47.4360, 85.8750}},
    {"Zhangmu", {27.9890, 85.9810}},    {"Gyirong", {28.3960, 85.3270}},    {"Tashkurgan", {37.7730, 75.2290}},
    {"Mohe", {52.9720, 122.5390}},      {"Mengla", {21.4790, 101.5650}},    {"Mohan", {21.1870, 101.6870}},
    {"Daluo", {21.6850, 100.0430}},     {"Menglian", {22.3290, 99.5840}},   {"Luohu", {22.5330, 114.1190}},
    {"Shekou", {22.4770, 113.9160}},    {"Gongbei", {22.2220, 113.5520}},   {"Hengqin", {22.1280, 113.5360}},
    {"Xiamen", {24.4500, 118.0800}},    {"Gulangyu", {24.4470, 118.0630}},  {"Zhoushan", {29.9850, 122.2070}},
    {"Shengsi", {30.7250, 122.4510}},   {"Pingtan", {25.5040, 119.7900}},   {"Haikou", {20.0440, 110.3420}},
    {"Sanya", {18.2520, 109.5120}},     {"Weizhou", {21.0480, 109.1170}},   {"Changhai", {39.2730, 122.5880}},
    {"Chongming", {31.6270, 121.3970}}, {"Nanao", {23.4210, 117.0240}},
};

constexpr Place kOutside[] = {
    {"Hong Kong", {22.2800, 114.1600}},    {"Kowloon", {22.3170, 114.1710}},
    {"Sheung Shui", {22.5010, 114.1280}},  {"Lok Ma Chau", {22.5150, 114.0655}},
    {"Tin Shui Wai", {22.4600, 114.0030}}, {"Lantau", {22.2570, 113.9500}},
    {"Cheung Chau", {22.2090, 114.0290}},  {"Hong Kong airport", {22.3080, 113.9185}},
    {"Macau", {22.1937, 113.5400}},        {"Macau, northern edge", {22.2120, 113.5490}},
    {"Taipa", {22.1560, 113.5560}},        {"Coloane", {22.1230, 113.5640}},
    {"Taipei", {25.0330, 121.5654}},       {"Kaohsiung", {22.6200, 120.3100}},
    {"Penghu", {23.5650, 119.5660}},       {"Kinmen", {24.4330, 118.3170}},
    {"Matsu", {26.1580, 119.9510}},        {"Lang Son", {21.8530, 106.7610}},
    {"Dong Dang", {21.9450, 106.6990}},    {"Cao Bang", {22.6660, 106.2580}},
    {"Lao Cai", {22.4856, 103.9707}},      {"Muse", {23.9860, 97.9040}},
    {"Laukkai", {23.6850, 98.7650}},       {"Mongla", {21.6700, 100.0350}},
    {"Sinuiju", {40.1000, 124.4000}},      {"Rason", {42.3440, 130.3960}},
    {"Khasan", {42.4300, 130.6460}},       {"Blagoveshchensk", {50.2900, 127.5270}},
    {"Zabaykalsk", {49.6530, 117.3290}},   {"Pogranichny", {44.4090, 131.3800}},
    {"Zamyn-Uud", {43.7200, 111.9030}},    {"Dostyk", {45.2550, 82.4870}},
    {"Zaysan", {47.4680, 84.8720}},        {"Naryn", {41.4290, 76.0000}},
    {"Murghab", {38.1700, 73.9650}},       {"Sost", {36.6910, 74.8210}},
    {"Leh", {34.1640, 77.5850}},           {"Gangtok", {27.3310, 88.6140}},
    {"Thimphu", {27.4720, 89.6390}},       {"Haa", {27.3870, 89.2800}},
    {"Tawang", {27.5860, 91.8650}},        {"Khabarovsk", {48.4810, 135.0720}},
    {"Ulaanbaatar", {47.9200, 106.9200}},  {"Seoul", {37.57, 126.98}},
    {"Fukuoka", {33.59, 130.40}},          {"Vladivostok", {43.12, 131.89}},
    {"Null Island", {0.0, 0.0}},           {"the antimeridian", {-16.5, 180.0}},
};

}  // namespace

TEST(MainlandAreaTest, TownsOfTheMainland_AreInside) {
    for (const Place& place : kInside) {
        EXPECT_TRUE(area().contains(place.coordinate)) << place.name;
    }
}

TEST(MainlandAreaTest, HongKongMacauTaiwanAndTownsOfNeighbours_AreOutside) {
    for (const Place& place : kOutside) {
        EXPECT_FALSE(area().contains(place.coordinate)) << place.name;
    }
}

TEST(MainlandAreaTest, ABorderOnLand_TakesAKilometre) {
    // Southwards over the border with Mongolia by Erenhot's longitude, and by a longitude in the desert.
    for (const double longitude : {111.977, 103.0}) {
        double latitude = 40.0;
        while (area().contains({latitude, longitude})) {
            latitude += 0.0001;
        }
        std::string reason;
        const auto map = WorldMap::read(KTR_RESOURCES "/maps/world.bin", reason);
        WorldMap::Outline strict = map->outline();
        strict.cityBorders.insert(strict.cityBorders.end(), strict.borders.begin(), strict.borders.end());
        strict.borders.clear();
        const MainlandArea exact(std::move(strict));
        double border = latitude;
        while (!exact.contains({border, longitude})) {
            border -= 0.0001;
        }
        const double metres = (latitude - border) * 111'200.0;
        EXPECT_GE(metres, MainlandArea::kBorderMetres * 0.99) << longitude;
        // Along a border that does not run due west the way is longer.
        EXPECT_LE(metres, MainlandArea::kBorderMetres * 3.0) << longitude;
    }
}

TEST(MainlandAreaTest, TheSea_BelongsToTheNearestShoreWithinTwelveMiles) {
    // East of Qinhuangdao and of Lianyungang, out to sea.
    EXPECT_TRUE(area().contains({39.85, 119.80}));
    EXPECT_FALSE(area().contains({39.30, 120.30}));
    // Between Shekou and the New Territories, either side of the middle of the bay.
    EXPECT_TRUE(area().contains({22.482, 113.925}));
    EXPECT_FALSE(area().contains({22.440, 113.955}));
    // The strait, and the open sea.
    EXPECT_FALSE(area().contains({24.50, 119.50}));
    EXPECT_FALSE(area().contains({15.0, 114.0}));
}

TEST(MainlandAreaTest, InvalidCoordinates_AreOutside) {
    EXPECT_FALSE(area().contains({std::nan(""), 116.0}));
    EXPECT_FALSE(area().contains({91.0, 116.0}));
    EXPECT_FALSE(area().contains({39.9, 400.0}));
    EXPECT_FALSE(MainlandArea({}).contains({39.9, 116.4}));
}

}  // namespace ktr::linux_
