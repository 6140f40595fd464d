#include "server/names/Gazetteer.h"

#include <gtest/gtest.h>

#include <GeographicLib/Geodesic.hpp>
#include <algorithm>
#include <random>
#include <sstream>
#include <utility>
#include <vector>

#include "server/page/PageTexts.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::server {

namespace {

constexpr const char* kTowns = R"(<?xml version="1.0"?>
<!DOCTYPE gweather SYSTEM "locations.dtd">
<gweather><region><_name>Europe</_name><country><_name msgctxt="Country">Egypt</_name>
<location><name>An airport</name><coordinates>0 0</coordinates></location>
<city><_name msgctxt="City in Egypt">Cairo</_name><coordinates>30.05 31.25</coordinates>
<location><name>Its airport</name><coordinates>30.1 31.4</coordinates></location></city>
<city><_name>Suva</_name><coordinates>-18.13 178.42</coordinates></city>
<city><_name>Nowhere</_name></city>
<city><_name>Beyond</_name><coordinates>91 0</coordinates></city>
<city><_name>Odd</_name><coordinates>1,2</coordinates></city>
</country></region></gweather>)";

std::string nearestTo(Gazetteer& towns, double latitude, double longitude) {
    return towns.nearest(latitude, longitude).town->name;
}

}  // namespace

TEST(GazetteerTest, Towns_AreRead) {
    const test::TemporaryFolder folder;
    Gazetteer towns({folder.write("towns.xml", kTowns).string(), folder.path().string()});
    EXPECT_EQ(towns.count(), 2U) << "airports are no towns, nor is what has no place on earth";
    EXPECT_EQ(nearestTo(towns, 29.0, 30.0), "Cairo");
    EXPECT_EQ(nearestTo(towns, -20.0, -179.0), "Suva") << "beyond the date line";
    EXPECT_EQ(nearestTo(towns, 90.0, 0.0), "Cairo");
    const auto cairo = towns.nearest(30.05, 32.25);
    EXPECT_NEAR(cairo.metres, 96475.0, 200.0);
    EXPECT_EQ(cairo.town->context, "City in Egypt");
    EXPECT_EQ(cairo.town->latitude, 30.05) << "its own place, not its airport's";
}

TEST(GazetteerTest, Nearest_IsTheOneOfAllTowns) {
    std::mt19937 chance(5);
    std::uniform_real_distribution<double> latitude(-90.0, 90.0), longitude(-180.0, 180.0);
    struct Place {
        double latitude, longitude;
    };
    const auto somewhere = [&] { return Place{latitude(chance), longitude(chance)}; };
    std::vector<Place> all;
    std::ostringstream document;
    document.precision(17);
    document << "<gweather>";
    for (int number = 0; number < 400; ++number) {
        all.push_back(somewhere());
        document << "<city><_name>" << number << "</_name><coordinates>" << all.back().latitude << ' '
                 << all.back().longitude << "</coordinates></city>";
    }
    document << "</gweather>";
    const test::TemporaryFolder folder;
    Gazetteer towns({folder.write("towns.xml", document.str()).string(), folder.path().string()});
    std::vector<Place> asked = {{90.0, 0.0}, {-90.0, 0.0}, {0.0, 180.0}, {0.0, -180.0}, {89.999, -3.0}};
    for (int times = 0; times < 1000; ++times) {
        asked.push_back(somewhere());
    }
    for (const Place& here : asked) {
        double least = 1e9;
        for (const Place& there : all) {
            double metres = 0.0;
            GeographicLib::Geodesic::WGS84().Inverse(here.latitude, here.longitude, there.latitude, there.longitude,
                                                     metres);
            least = std::min(least, metres);
        }
        EXPECT_DOUBLE_EQ(towns.nearest(here.latitude, here.longitude).metres, least)
            << here.latitude << ' ' << here.longitude;
    }
}

TEST(GazetteerTest, WhatIsNoSuchFile_LeavesTheBuiltInTowns) {
    const test::TemporaryFolder folder;
    const std::string bomb = R"(<?xml version="1.0"?><!DOCTYPE g [<!ENTITY a "aaaaaaaaaa"><!ENTITY b "&a;&a;&a;&a;">]>
<g><city><_name>&b;</_name><coordinates>1 2</coordinates></city></g>)";
    for (const std::string& file :
         {std::string("/nonexistent"), folder.path().string(), folder.write("empty.xml", "").string(),
          folder.write("broken.xml", "<g><city><_name>A</_name><coordinates>1 2</coordinates></city>").string(),
          folder.write("bomb.xml", bomb).string()}) {
        Gazetteer towns({file, folder.path().string()});
        EXPECT_EQ(nearestTo(towns, 51.0, -1.0), "London") << file;
        EXPECT_EQ(towns.name(*towns.nearest(51.0, -1.0).town, "fr"), "Londres") << file;
        EXPECT_EQ(towns.name(*towns.nearest(51.0, -1.0).town, "en-GB"), "London") << file;
        EXPECT_EQ(towns.name(*towns.nearest(40.0, 116.0).town, "de"), "Beijing") << file << ": no zone has its name";
    }
}

/// The package of the towns is one that the project's tests install.
class InstalledGazetteerTest : public ::testing::Test {
  protected:
    Gazetteer towns_{Gazetteer::Files()};
};

TEST_F(InstalledGazetteerTest, ItHasTheWorldsTowns) {
    EXPECT_GT(towns_.count(), 4000U);
    EXPECT_EQ(nearestTo(towns_, 50.60, -3.60), "Exeter");
    EXPECT_EQ(nearestTo(towns_, 48.1, 11.5), "Munich");
}

TEST_F(InstalledGazetteerTest, NearATown_FewTownsAreCompared) {
    for (const auto& [latitude, longitude] : {std::pair(50.7, -3.5), {48.1, 11.5}, {35.7, 139.7}, {-33.9, 151.2}}) {
        const std::uint64_t before = towns_.compared();
        towns_.nearest(latitude, longitude);
        EXPECT_LT(towns_.compared() - before, towns_.count() / 20) << latitude;
    }
}

TEST_F(InstalledGazetteerTest, Names_AreInTheViewersLanguage) {
    const auto munich = towns_.nearest(48.14, 11.58);
    const std::map<std::string, std::string> names = {{"en", "Munich"},    {"de", "München"},      {"de-AT", "München"},
                                                      {"pl", "Monachium"}, {"it", "Monaco"},       {"ru", "Мюнхен"},
                                                      {"pt", "Munique"},   {"pt-PT", "Munique"},   {"xx", "Munich"},
                                                      {"", "Munich"},      {"../../etc", "Munich"}};
    for (const auto& [language, name] : names) {
        EXPECT_EQ(towns_.name(*munich.town, language), name) << language;
    }
    const auto peking = towns_.nearest(39.9, 116.4);
    EXPECT_EQ(towns_.name(*peking.town, "zh-Hans"), "北京");
    EXPECT_EQ(towns_.name(*peking.town, "zh-Hant-HK"), "北京");
    EXPECT_EQ(towns_.name(*towns_.nearest(30.05, 31.25).town, "fr"), "Le Caire") << "it has a context";
}

TEST_F(InstalledGazetteerTest, MostTowns_HaveANameInEachLanguage) {
    // Those in other letters tell a translation from none.
    std::mt19937 chance(8);
    std::uniform_real_distribution<double> latitude(-55.0, 70.0), longitude(-180.0, 180.0);
    for (const char* language : {"ar", "el", "fa", "he", "hi", "ja", "ru", "uk", "zh-Hans", "zh-Hant"}) {
        int translated = 0;
        for (int times = 0; times < 300; ++times) {
            const auto town = towns_.nearest(latitude(chance), longitude(chance));
            translated += towns_.name(*town.town, language) != town.town->name ? 1 : 0;
        }
        // Of Greek and Hebrew the data has few.
        const std::string_view name = language;
        EXPECT_GT(translated, name == "el" || name == "he" ? 35 : 150) << language;
    }
}

TEST_F(InstalledGazetteerTest, AllLanguagesTogether_StaySmall) {
    const auto town = towns_.nearest(48.14, 11.58);
    for (const auto language : PageTexts::languages()) {
        towns_.name(*town.town, std::string(language));
    }
    EXPECT_LT(towns_.bytes(), std::size_t{8} << 20);
}

}  // namespace ktr::server
