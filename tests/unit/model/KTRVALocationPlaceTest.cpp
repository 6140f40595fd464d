// Where a record's friend is, how far away, and what they look like.
#include "model/KTRVALocation.h"

#include <cmath>

#include "model/PluginBundle.h"
#include "tests/unit/model/KTRVALocationFixture.h"

namespace ktr::test {
namespace {

using platform::VAKtrLocation;
using platform::VAPerson;

// Where it is.

TEST_F(KTRVALocationTest, HasCoordinate_NeedsBothAndTakesZero) {
    const auto made = nobody();
    EXPECT_FALSE(made->hasCoordinate());
    made->velaLocation()->latitude = 0.0;
    EXPECT_FALSE(made->hasCoordinate());
    made->velaLocation()->longitude = 0.0;
    EXPECT_TRUE(made->hasCoordinate());
    EXPECT_FALSE(KTRVALocation::locationWithVelaLocation(nullptr)->hasCoordinate());
}

TEST_F(KTRVALocationTest, Line_OfCityAndState) {
    const auto line = [](const std::optional<std::string>& city, const std::optional<std::string>& state) {
        const auto made = nobody();
        made->velaLocation()->city = city;
        made->velaLocation()->stateCode = state;
        return made->friendLocation(true);
    };
    EXPECT_EQ(line("Springfield", "IL"), "Springfield, IL");
    EXPECT_EQ(line("Singapore", "Singapore"), "Singapore");
    EXPECT_EQ(line("singapore", "Singapore"), "singapore, Singapore") << "compared exactly";
    EXPECT_EQ(line("Springfield", std::nullopt), "Springfield");
    EXPECT_EQ(line(std::nullopt, "IL"), "IL");
    EXPECT_EQ(line(std::nullopt, std::nullopt), "NO_LOCATION");
}

TEST_F(KTRVALocationTest, Line_APresentEmptyTextCounts_IsKept) {
    const auto made = nobody();
    made->velaLocation()->city = "";
    EXPECT_EQ(made->friendLocation(true), "");
    made->velaLocation()->stateCode = "IL";
    EXPECT_EQ(made->friendLocation(true), ", IL");
    made->velaLocation()->label = "";
    EXPECT_EQ(made->friendLocation(true), "");
}

TEST_F(KTRVALocationTest, Line_TheLabelGoesFirstAsItStands) {
    const auto made = nobody();
    made->velaLocation()->city = "Springfield";
    made->velaLocation()->stateCode = "IL";
    made->velaLocation()->label = "_$!<Work>!$_";
    EXPECT_EQ(made->friendLocation(true), "_$!<Work>!$_");
    EXPECT_EQ(made->friendLocation(false), "_$!<Work>!$_");
}

TEST_F(KTRVALocationTest, Line_WithoutAPlaceDependsOnTheRefresh) {
    EXPECT_EQ(nobody()->friendLocation(true), "NO_LOCATION");
    EXPECT_EQ(nobody()->friendLocation(false), "LOCATING");
    EXPECT_EQ(KTRVALocation::locationWithVelaLocation(nullptr)->friendLocation(false), "LOCATING");
}

// How far away it is.

TEST_F(KTRVALocationTest, Distance_IsTheCalculatorsText) {
    const auto made = record(person({"a@b"}, {}, "Ann"));
    made->velaLocation()->latitude = 48.0;
    made->velaLocation()->longitude = 11.01;
    EXPECT_EQ(made->distanceFromLocation(position(48.0, 11.0)), "744 m");
    EXPECT_TRUE(log->has(platform::LogLevel::Debug, "Distance calculated: 744 m for friend: Ann (Unit:0)"));
}

TEST_F(KTRVALocationTest, Distance_ThatCannotBeMeasuredIsNone) {
    const auto made = record(person({"a@b"}, {}, "Ann"));
    made->velaLocation()->latitude = std::nan("");
    made->velaLocation()->longitude = 11.01;
    EXPECT_EQ(made->distanceFromLocation(position(48.0, 11.0)), std::nullopt);
    EXPECT_TRUE(log->has(platform::LogLevel::Debug, "Distance calculated: (null) for friend: Ann (Unit:0)"));
}

TEST_F(KTRVALocationTest, Distance_FromNowhereDoesNotTouchTheCalculator) {
    const auto made = nobody();
    made->velaLocation()->latitude = 48.0;
    made->velaLocation()->longitude = 11.0;
    EXPECT_EQ(made->distanceFromLocation(nullptr), std::nullopt);
    EXPECT_TRUE(distances->made.empty());
    EXPECT_TRUE(log->lines().empty());
}

TEST_F(KTRVALocationTest, Distance_ToNowhereOrTheEquatorIsNone_IsKept) {
    const auto made = nobody();
    EXPECT_EQ(made->distanceFromLocation(position(48.0, 11.0)), std::nullopt);
    made->velaLocation()->latitude = 0.0;
    made->velaLocation()->longitude = 11.0;
    EXPECT_EQ(made->distanceFromLocation(position(48.0, 11.0)), std::nullopt);
    made->setVelaLocation(nullptr);
    EXPECT_EQ(made->distanceFromLocation(position(48.0, 11.0)), std::nullopt);
    EXPECT_TRUE(distances->made.empty());
}

TEST_F(KTRVALocationTest, DistanceCalculator_IsMadeOnceWithItsFourSettings) {
    assistant->language = "de-CH";
    region->locale = "en-US";
    EXPECT_EQ(KTRVALocation::distanceCalculator(), KTRVALocation::distanceCalculator());
    ASSERT_EQ(distances->made.size(), 1U);
    const auto& settings = distances->made[0];
    EXPECT_EQ(settings.defaultsSuite, "group.org.ktr");
    EXPECT_EQ(settings.languageLocale, "de-CH");
    EXPECT_EQ(settings.measurementSystemLocale, "en-US");
    EXPECT_EQ(settings.localizationDelegate, localization);
}

TEST_F(KTRVALocationTest, DistanceCalculator_WithoutAnAssistantLanguageHasNone) {
    assistant->language = std::nullopt;
    KTRVALocation::distanceCalculator();
    EXPECT_EQ(distances->made.at(0).languageLocale, std::nullopt);
}

// What they look like.

TEST_F(KTRVALocationTest, Picture_ByAssistantIdentifierFirst) {
    addContact("7", std::nullopt, std::nullopt, "image by identifier");
    addContact("8", "a@b", std::nullopt, "image by email");
    const auto ann = person({"a@b"}, {});
    ann->identifier = "assistant:7";
    EXPECT_EQ(imageName(record(ann)->friendImage()), "image by identifier");
}

TEST_F(KTRVALocationTest, Picture_ByHandleWhenTheIdentifiedContactHasNone) {
    addContact("7", std::nullopt, std::nullopt);
    addContact("8", "a@b", std::nullopt, "image by email");
    const auto ann = person({"a@b"}, {});
    ann->identifier = "assistant:7";
    EXPECT_EQ(imageName(record(ann)->friendImage()), "image by email");
    ann->identifier = std::nullopt;
    EXPECT_EQ(imageName(record(ann)->friendImage()), "image by email");
}

TEST_F(KTRVALocationTest, Picture_TriesTheFirstAddressFirst) {
    addContact("1", "first@b", std::nullopt, "image first");
    addContact("2", "last@b", std::nullopt, "image last");
    EXPECT_EQ(imageName(KTRVALocation::friendImageForVAPerson(person({"first@b", "last@b"}, {}))), "image first");
    EXPECT_EQ(imageName(KTRVALocation::friendImageForVAPerson(person({"unknown@b", "last@b"}, {}))), "image last");
}

TEST_F(KTRVALocationTest, Picture_ByPhoneAfterEveryAddress) {
    addContact("1", "first@b", std::nullopt);
    addContact("2", std::nullopt, "07700 900123", "image phone");
    EXPECT_EQ(imageName(KTRVALocation::friendImageForVAPerson(person({"first@b"}, {"5", "+447700900123"}))),
              "image phone");
}

TEST_F(KTRVALocationTest, Picture_OfNobodyOrAnotherKindIsNone) {
    EXPECT_EQ(nobody()->friendImage(), nullptr);
    EXPECT_EQ(KTRVALocation::locationWithVelaLocation(nullptr)->friendImage(), nullptr);
    EXPECT_EQ(KTRVALocation::friendImageForVAPerson(nullptr), nullptr);
    EXPECT_EQ(KTRVALocation::friendImageForVAPerson(std::make_shared<VAKtrLocation>()), nullptr);
    EXPECT_EQ(KTRVALocation::friendImageForVAPerson(person({"a@b", std::nullopt}, {std::nullopt})), nullptr);
}

TEST_F(KTRVALocationTest, TheBundleIsThePlugins) {
    EXPECT_EQ(KTRVALocation::bundle(), PluginBundle::bundle());
}

// Log lines.

TEST_F(KTRVALocationTest, LogLinesAndTheirLevels) {
    KTRVALocation::locationWithHandle("ann@example.com", person({"ann@example.com"}, {}, "Ann"), std::nullopt);
    const auto made = record(person({"a@b"}, {}, "Ann"));
    made->velaLocation()->latitude = 48.0;
    made->velaLocation()->longitude = 11.01;
    made->distanceFromLocation(position(48.0, 11.0));
    const auto lines = log->lines();
    ASSERT_EQ(lines.size(), 2U);
    struct Case {
        platform::LogLevel level;
        const char* format;
        const char* text;
    };
    const std::vector<Case> expected = {
        {platform::LogLevel::Debug, "VAPerson found: %@", "VAPerson found: <VAPerson Ann>"},
        {platform::LogLevel::Debug, "Distance calculated: %@ for friend: %@ (Unit:%li)",
         "Distance calculated: 744 m for friend: Ann (Unit:0)"},
    };
    for (std::size_t i = 0; i < expected.size(); ++i) {
        EXPECT_EQ(lines[i].level, expected[i].level);
        EXPECT_EQ(lines[i].format, expected[i].format);
        EXPECT_EQ(lines[i].text, expected[i].text);
        EXPECT_EQ(lines[i].subsystem, "org.ktr.snippets");
    }
}

}  // namespace
}  // namespace ktr::test
