#include "serve/FriendsReader.h"

#include <gtest/gtest.h>

namespace ktr::test {

using documents::DocumentError;
using serve::FriendsFile;
using serve::FriendsReader;
using serve::ServedFriend;

class FriendsReaderTest : public ::testing::Test {
  protected:
    static FriendsFile good(const std::string& text) {
        const auto read = FriendsReader::readText(text, "f.json");
        const auto* error = std::get_if<DocumentError>(&read);
        EXPECT_EQ(error, nullptr) << (error != nullptr ? error->text() : "");
        return error != nullptr ? FriendsFile() : std::get<FriendsFile>(read);
    }
    static std::string complaintOf(const std::string& text) {
        const auto read = FriendsReader::readText(text, "f.json");
        const auto* error = std::get_if<DocumentError>(&read);
        return error != nullptr ? error->path + ": " + error->message : "no error";
    }
};

TEST_F(FriendsReaderTest, DemoPeople_AreWellFormed) {
    const auto read = FriendsReader::readFile(KTR_SOURCE_DIR "/resources/service/friends.json");
    ASSERT_TRUE(std::holds_alternative<FriendsFile>(read));
    const auto& friends = std::get<FriendsFile>(read).friends;
    EXPECT_GE(friends.size(), 5U);
    EXPECT_EQ(friends[0].firstName, "Ann");
    EXPECT_TRUE(friends[0].placeAt(0.0).has_value());
}

TEST_F(FriendsReaderTest, Person_MovesBetweenWaypoints) {
    const ServedFriend person = good(R"({"friends": [{"emails": "a@b.example", "track": [
        {"at": 0, "latitude": 10, "longitude": 20, "street": "One"}, {"at": 100, "latitude": 20, "longitude": 40, "street": "Two"}]}]})")
                                    .friends.at(0);
    EXPECT_EQ(person.placeAt(0.0)->latitude, 10.0);
    EXPECT_EQ(person.placeAt(25.0)->latitude, 12.5);
    EXPECT_EQ(person.placeAt(25.0)->longitude, 25.0);
    EXPECT_EQ(person.placeAt(99.0)->street, "One");
    EXPECT_EQ(person.placeAt(100.0)->street, "Two");
    EXPECT_EQ(person.placeAt(125.0)->latitude, 12.5) << "the track begins anew";
}

TEST_F(FriendsReaderTest, LateHiddenAndLostPeople_HaveNoPlace) {
    const auto friends = good(R"({"friends": [
        {"phones": "1", "locatedAfter": 5, "repeats": false, "track": [{"latitude": 1, "longitude": 2}]},
        {"phones": "2", "hidden": true, "track": [{"latitude": 1, "longitude": 2}]}, {"phones": "3"}]})")
                             .friends;
    EXPECT_EQ(friends.at(0).placeAt(4.9), std::nullopt);
    EXPECT_NE(friends.at(0).placeAt(5.0), std::nullopt);
    EXPECT_NE(friends.at(0).placeAt(500.0), std::nullopt);
    EXPECT_EQ(friends.at(1).placeAt(0.0), std::nullopt);
    EXPECT_EQ(friends.at(2).placeAt(0.0), std::nullopt);
}

TEST_F(FriendsReaderTest, WaypointThatHides_IsNoPlaceUntilTheNext) {
    const auto friends = good(R"({"friends": [
        {"phones": "1", "repeats": false, "track": [{"latitude": 1, "longitude": 2},
            {"at": 10, "latitude": 1, "longitude": 2, "hidden": true}, {"at": 20, "latitude": 3, "longitude": 2}]},
        {"phones": "2", "track": [{"at": 5, "latitude": 1, "longitude": 2, "hidden": true}]}]})")
                             .friends;
    EXPECT_NE(friends.at(0).placeAt(9.9), std::nullopt);
    EXPECT_EQ(friends.at(0).placeAt(10.0), std::nullopt);
    EXPECT_EQ(friends.at(0).placeAt(19.9), std::nullopt);
    EXPECT_EQ(friends.at(0).placeAt(20.0)->latitude, 3.0);
    EXPECT_EQ(friends.at(1).placeAt(0.0), std::nullopt);
    EXPECT_EQ(friends.at(1).placeAt(5.0), std::nullopt);
}

TEST_F(FriendsReaderTest, Scenario_GivesPeopleWhoStay) {
    const auto friends = good(R"({"snippet": {"kind": "VAKtrLocationSnippet", "locations": [
        {"friend": {"data": "ann@b.example", "object": {"fullName": "Ann", "phones": [{"number": "+44 1"}]}},
         "latitude": 1, "longitude": 2, "label": "Home"}, {"friend": {"data": "+45 2"}}]}})")
                             .friends;
    ASSERT_EQ(friends.size(), 2U);
    EXPECT_EQ(friends[0].fullName, "Ann");
    EXPECT_TRUE(friends[0].answersTo("ANN@B.example"));
    EXPECT_TRUE(friends[0].answersTo("+441"));
    EXPECT_EQ(friends[0].placeAt(1000.0)->label, "Home");
    EXPECT_EQ(friends[1].placeAt(0.0), std::nullopt);
}

TEST_F(FriendsReaderTest, User_IsNamedOrSomebodyOfTheService) {
    EXPECT_EQ(good(R"({"friends": []})").user.handle(), "mara.lind@harbour.example");
    const auto named = good(R"({"friends": [], "user": {"fullName": "Me", "phones": "+44 1"}})").user;
    EXPECT_EQ(named.fullName, "Me");
    EXPECT_EQ(named.handle(), "+44 1");
    EXPECT_EQ(good(R"({"snippet": {}, "account": {"userName": "me@b.example"}})").user.handle(), "me@b.example");
    EXPECT_EQ(good(R"({"snippet": {}, "account": {"userName": "+44 2"}})").user.phones.front(), "+44 2");
    EXPECT_EQ(complaintOf(R"({"friends": [], "user": {}})"),
              "$.user: expected at least one of \"emails\" and \"phones\"");
}

TEST_F(FriendsReaderTest, Errors_NameThePlace) {
    EXPECT_EQ(complaintOf("{}"), "$: expected a member \"friends\", or a scenario's \"snippet\"");
    EXPECT_EQ(complaintOf(R"({"friends": [{}]})"), "$.friends[0]: expected at least one of \"emails\" and \"phones\"");
    EXPECT_EQ(complaintOf(R"({"friends": [{"phones": "1", "track": [{"latitude": 91, "longitude": 0}]}]})"),
              "$.friends[0].track[0].latitude: expected a number from -90 to 90");
    EXPECT_EQ(
        complaintOf(
            R"({"friends": [{"phones": "1", "track": [{"latitude": 1, "longitude": 0}, {"latitude": 1, "longitude": 0}]}]})"),
        "$.friends[0].track[1].at: expected the waypoints in the order of their time");
}

}  // namespace ktr::test
