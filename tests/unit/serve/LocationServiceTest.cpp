#include "serve/LocationService.h"

#include <gtest/gtest.h>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"

namespace ktr::test {

using serve::Fault;
using serve::FriendsFile;
using serve::LocationService;
using serve::ServedFriend;

class LocationServiceTest : public ::testing::Test {
  protected:
    static FriendsFile people() {
        FriendsFile file;
        ServedFriend ann;
        ann.emails = {"ann@b.example"};
        ann.phones = {"+44 1632 960001"};
        ann.track = {{0.0, 51.5, -2.5, 8.0, "Quay", "Bristol", "ENG", "Work"}};
        ServedFriend bo;
        bo.phones = {"+44 1632 960002"};
        ServedFriend cy;
        cy.emails = {"cy@b.example"};
        cy.hidden = true;
        file.friends = {ann, bo, cy};
        return file;
    }
    std::string answer(const std::string& request, const Fault& fault = {}) const {
        const auto read = documents::JsonReader::read(request);
        std::string complaint;
        const auto given = service.getLocations(*std::get<platform::Value>(read).dictionary(), {0.0, 1700000000123.4},
                                                fault, complaint);
        return given ? platform::writeJson(*given) : complaint;
    }
    std::string command(const std::string& request, const Fault& fault = {}) const {
        const auto read = documents::JsonReader::read(request);
        std::string complaint;
        const auto given = service.showHideLocation(*std::get<platform::Value>(read).dictionary(),
                                                    {0.0, 1700000000123.4}, fault, complaint);
        return given ? platform::writeJson(*given) : complaint;
    }
    LocationService service{people()};
};

TEST_F(LocationServiceTest, Answer_IsOneEntryAFriendUnderTheMailAddressAskedFor) {
    EXPECT_EQ(
        answer(R"({"clientContext": {}, "handles": ["+441632960001", "Ann@b.example", "x@y.example", "+441632960002"],
                         "serverContext": {"clientId": "c"}})"),
        R"({"statusCode":200,"serverContext":{"minCallbackIntervalInMS":10000,"callbackTimeoutIntervalInMS":600000,)"
        R"("clientId":"c"},"locations":{"Ann@b.example":{"status":200,"location":{"latitude":51.5,"longitude":-2.5,)"
        R"("horizontalAccuracy":8,"timestamp":1700000000123,"streetAddress":"Quay","address":{"locality":"Bristol",)"
        R"("stateCode":"ENG"},"labels":[{"label":"Work"}]}},"+441632960002":{"status":200,"location":null}},)"
        R"("emails":["Ann@b.example","+441632960002"]})");
}

TEST_F(LocationServiceTest, ZeroPosition_CountsAsUnknown) {
    const std::string known = answer(R"({"clientContext": {}, "handles": ["ann@b.example"],
        "myLocation": {"latitude": 51.5, "longitude": -2.5}, "requestedLocation": {"latitude": 51.5, "longitude": -2.6}})");
    EXPECT_NE(known.find(R"("distanceInMeters":"0","match":false)"), std::string::npos) << known;
    const std::string unknown = answer(R"({"clientContext": {}, "handles": ["ann@b.example"],
        "myLocation": {"latitude": 0, "longitude": 0}, "requestedLocation": {"latitude": 0, "longitude": 0}})");
    EXPECT_EQ(unknown.find("distanceInMeters"), std::string::npos);
    EXPECT_EQ(unknown.find("match"), std::string::npos);
}

TEST_F(LocationServiceTest, Faults_ChangeStatusIntervalAndEntries) {
    const std::string request =
        R"({"clientContext": {}, "handles": ["ann@b.example", "+441632960002", "cy@b.example"]})";
    EXPECT_NE(answer(request).find(R"("cy@b.example":{"status":411,"location":null})"), std::string::npos);
    Fault partial;
    partial.statusCode = 416;
    EXPECT_EQ(answer(request, partial).rfind(R"({"statusCode":416,)", 0), 0U);
    EXPECT_NE(answer(request, partial).find(R"("emails":["ann@b.example","+441632960002"]})"), std::string::npos);
    Fault dropped;
    dropped.entryStatus = 411;
    dropped.entry = "+44 1632 960002";
    dropped.intervalSeconds = 0.0;
    const std::string given = answer(request, dropped);
    EXPECT_NE(given.find(R"("+441632960002":{"status":411)"), std::string::npos);
    EXPECT_NE(given.find(R"("ann@b.example":{"status":200)"), std::string::npos);
    EXPECT_NE(given.find(R"("minCallbackIntervalInMS":0,)"), std::string::npos);
}

TEST_F(LocationServiceTest, WrongRequest_IsRefusedWithThePlace) {
    EXPECT_EQ(answer("{}"), "$.clientContext: expected an object, found nothing");
    EXPECT_EQ(answer(R"({"clientContext": {}, "handles": [1]})"), "$.handles[0]: expected a string, found a number");
    EXPECT_EQ(answer(R"({"clientContext": {}, "myLocation": {"latitude": 1}})"),
              "$.myLocation: expected a latitude and a longitude in degrees");
}

TEST_F(LocationServiceTest, ShowingTheUser_AnswersWithTheUsersPlace) {
    EXPECT_EQ(
        command(
            R"({"clientContext": {"location": {"latitude": 51.5003, "longitude": -2.5, "horizontalAccuracy": 8}}, "prefs": {"hideLocation": "No"}})"),
        R"({"statusCode":200,"serverContext":{"minCallbackIntervalInMS":10000,"callbackTimeoutIntervalInMS":600000},)"
        R"("myInfo":{"preferredEmail":"mara.lind@harbour.example","hidden":false,"location":{"latitude":51.5003,)"
        R"("longitude":-2.5,"horizontalAccuracy":8,"timestamp":1700000000123,"streetAddress":"Quay",)"
        R"("address":{"locality":"Bristol","stateCode":"ENG"},"labels":null}}})");
}

TEST_F(LocationServiceTest, PlaceFarFromEveryStreet_HasItsTownAlone) {
    EXPECT_EQ(service.placeAt(51.51, -2.5).street, std::nullopt);
    EXPECT_EQ(service.placeAt(51.51, -2.5).city, "Bristol");
    EXPECT_EQ(service.placeAt(52.5, -2.5).city, std::nullopt);
}

TEST_F(LocationServiceTest, Hiding_IsKeptAndGivesNoPlaceAway) {
    EXPECT_FALSE(service.sharing().now().hidden);
    const std::string hidden = command(
        R"({"clientContext": {"location": {"latitude": 51.5, "longitude": -2.5}}, "prefs": {"hideLocation": "Yes"}})");
    EXPECT_NE(hidden.find(R"("hidden":true,"location":null)"), std::string::npos) << hidden;
    EXPECT_TRUE(service.sharing().now().hidden);
    // What was known before is shown again, also when the client knows no place now.
    const std::string shown = command(
        R"({"clientContext": {"location": {"latitude": 0, "longitude": 0, "source": "assistant"}}, "prefs": {"hideLocation": "No"}})");
    EXPECT_NE(shown.find(R"("hidden":false,"location":{"latitude":51.5,)"), std::string::npos) << shown;
    EXPECT_FALSE(service.sharing().now().hidden);
}

TEST_F(LocationServiceTest, WishToBeHidden_IsNotUndoneByACommand) {
    service.sharing().wish(true);
    const std::string answer = command(
        R"({"clientContext": {"location": {"latitude": 51.5, "longitude": -2.5}}, "prefs": {"hideLocation": "No"}})");
    EXPECT_NE(answer.find(R"("hidden":true,"location":null)"), std::string::npos) << answer;
    service.sharing().wish(false);
    EXPECT_NE(command(R"({"clientContext": {}, "prefs": {"hideLocation": "No"}})").find(R"("latitude":51.5)"),
              std::string::npos);
}

TEST_F(LocationServiceTest, ShowingWithoutAPlace_IsNoPlace) {
    const std::string shown = command(R"({"clientContext": {}, "prefs": {"hideLocation": "No"}})");
    EXPECT_NE(shown.find(R"("location":null)"), std::string::npos) << shown;
}

TEST_F(LocationServiceTest, UserKnownByPhone_HasNoPreferredAddress) {
    FriendsFile file;
    file.user = ServedFriend();
    file.user.phones = {"+44 1632 960018"};
    EXPECT_EQ(file.user.handle(), "+44 1632 960018");
    LocationService other(file);
    std::string complaint;
    const auto answer = other.showHideLocation(
        {{"clientContext", platform::Dictionary{}}, {"prefs", platform::Dictionary{{"hideLocation", "No"}}}}, {}, {},
        complaint);
    ASSERT_TRUE(answer.has_value()) << complaint;
    EXPECT_EQ(answer->find("myInfo")->dictionary()->find("preferredEmail"), nullptr);
}

TEST_F(LocationServiceTest, FailingSharingCommand_ChangesNothing) {
    Fault fault;
    fault.status = 503;
    command(R"({"clientContext": {}, "prefs": {"hideLocation": "Yes"}})", fault);
    EXPECT_FALSE(service.sharing().now().hidden);
}

TEST_F(LocationServiceTest, WrongSharingCommand_IsRefusedWithThePlace) {
    EXPECT_EQ(command(R"({"prefs": {"hideLocation": "No"}})"), "$.clientContext: expected an object, found nothing");
    for (const char* request : {R"({"clientContext": {}})", R"({"clientContext": {}, "prefs": {}})",
                                R"({"clientContext": {}, "prefs": {"hideLocation": "Maybe"}})"}) {
        EXPECT_EQ(command(request), R"($.prefs: expected "hideLocation" to be "Yes" or "No")") << request;
    }
    EXPECT_EQ(command(R"({"clientContext": {}, "prefs": {"hideLocation": true}})"),
              "$.prefs.hideLocation: expected a string, found a boolean");
    EXPECT_EQ(command(R"({"clientContext": {"location": {"latitude": 1}}, "prefs": {"hideLocation": "No"}})"),
              "$.clientContext.location: expected a latitude and a longitude in degrees");
    EXPECT_FALSE(service.sharing().now().hidden);
}

}  // namespace ktr::test
