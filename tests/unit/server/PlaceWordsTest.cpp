#include "server/names/PlaceWords.h"

#include <gtest/gtest.h>

#include "documents/JsonReader.h"
#include "server/page/PageTexts.h"

namespace ktr::server {

namespace {

std::string nearIn(const std::string& language, const std::string& region, double metres = 40234.0) {
    return PlaceWords({language, region}).near("Exeter", metres);
}

ViewerLocale localeOf(const std::string& json) {
    const auto document = documents::JsonReader::read(json);
    return ViewerLocale::of(*std::get<platform::Value>(document).dictionary());
}

}  // namespace

TEST(PlaceWordsTest, Units_AreTheRegions) {
    EXPECT_EQ(nearIn("en", "DE"), "near Exeter, 40\u00a0km");
    EXPECT_EQ(nearIn("en-GB", "GB"), "near Exeter, 25\u00a0mi");
    EXPECT_EQ(nearIn("en-GB", ""), "near Exeter, 25\u00a0mi");
    EXPECT_EQ(nearIn("de", "US"), "bei Exeter, 25\u00a0mi");
    EXPECT_EQ(nearIn("de-DE", ""), "bei Exeter, 40\u00a0km");
    EXPECT_EQ(nearIn("en", "DE", 2500.0), "near Exeter, 2.5\u00a0km") << "numbers are the language's";
    EXPECT_EQ(nearIn("ar", "EG").find("٤٠") != std::string::npos, true) << "digits are those of the region";
    EXPECT_EQ(nearIn("ar", "AE").find("40") != std::string::npos, true);
    EXPECT_EQ(nearIn("", ""), nearIn("en", ""));
}

TEST(PlaceWordsTest, ALanguageWithoutTexts_ReadsEnglish) {
    EXPECT_EQ(nearIn("cs-CZ", "CZ"), "near Exeter, 40\u00a0km");
    EXPECT_EQ(PlaceWords({"cs-CZ", "CZ"}).language(), "en");
    EXPECT_EQ(PlaceWords({"pt-PT", "PT"}).language(), "pt-PT");
    EXPECT_EQ(PlaceWords({"zh-TW", "TW"}).street("中山路", "台北"), "台北 中山路");
    EXPECT_EQ(PlaceWords({"iw", "IL"}).language(), "he");
}

TEST(PlaceWordsTest, Coordinates_AreInWords) {
    const PlaceWords english({"en", "GB"});
    EXPECT_EQ(english.coordinates(50.2104, -3.12), "50.21° north, 3.12° west");
    EXPECT_EQ(english.coordinates(-33.8688, 151.2093), "33.87° south, 151.21° east");
    EXPECT_EQ(english.coordinates(0.0, 0.0), "0.00° north, 0.00° east");
    EXPECT_EQ(english.coordinates(-0.004, -0.004), "0.00° north, 0.00° east") << "no side for a zero";
    EXPECT_EQ(PlaceWords({"de", "DE"}).coordinates(50.2104, -3.12), "50,21° Nord, 3,12° West");
    EXPECT_EQ(PlaceWords({"ja", "JP"}).coordinates(35.68, 139.69), "北緯35.68°、東経139.69°");
    EXPECT_EQ(PlaceWords({"fa", "IR"}).coordinates(35.68, 51.39), "\u2068۳۵٫۶۸° شمالی\u2069، \u2068۵۱٫۳۹° شرقی\u2069");
}

TEST(PlaceWordsTest, EveryLanguage_HasWordsOfItsOwn) {
    for (const auto language : PageTexts::languages()) {
        const PlaceWords words({std::string(language), ""});
        for (const std::string& text : {words.near("Exeter", 40000.0), words.coordinates(1.0, 2.0),
                                        words.coordinates(-1.0, -2.0), words.street("Quay Road", "Brinmouth")}) {
            EXPECT_EQ(text.find('%'), std::string::npos) << language << ": " << text;
            EXPECT_EQ(text.find('_'), std::string::npos) << language << ": " << text;
        }
        EXPECT_NE(words.near("Exeter", 40000.0).find("Exeter"), std::string::npos) << language;
        EXPECT_NE(words.coordinates(1.0, 2.0), words.coordinates(-1.0, 2.0)) << language;
        EXPECT_NE(words.coordinates(1.0, 2.0), words.coordinates(1.0, -2.0)) << language;
        if (language != "en") {
            EXPECT_NE(words.near("Exeter", 40000.0), nearIn("en", "DE", 40000.0)) << language;
        }
    }
}

TEST(PlaceWordsTest, AStreetAlone_IsItsName) {
    EXPECT_EQ(PlaceWords({"en", ""}).street("Quay Road", ""), "Quay Road");
    EXPECT_EQ(PlaceWords({"en", ""}).street("Quay Road", "Brinmouth"), "Quay Road, Brinmouth");
}

TEST(ViewerLocaleTest, Context_IsReadAsFarAsItMakesSense) {
    EXPECT_EQ(localeOf(R"({"locale":"de-AT","regionCode":"AT","countryCode":"DE"})"), (ViewerLocale{"de-AT", "AT"}));
    EXPECT_EQ(localeOf(R"({"locale":"en_GB","regionCode":"gb"})"), (ViewerLocale{"en-GB", "gb"}));
    EXPECT_EQ(localeOf("{}"), ViewerLocale());
    EXPECT_EQ(localeOf(R"({"locale":null,"regionCode":7})"), ViewerLocale());
    EXPECT_EQ(localeOf(R"({"locale":"../../de","regionCode":"GBR"})"), ViewerLocale());
    EXPECT_EQ(localeOf(R"({"locale":")" + std::string(36, 'a') + R"(","regionCode":"4%"})"), ViewerLocale());
}

}  // namespace ktr::server
