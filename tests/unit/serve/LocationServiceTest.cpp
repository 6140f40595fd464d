#include "serve/LocationService.h"

#include <gtest/gtest.h>

#include <future>

#include "documents/JsonReader.h"
#include "platform/base/Json.h"
#include "server/ingest/PhoneMessages.h"

namespace ktr::test {

using platform::Dictionary;
using platform::Value;
using serve::Fault;
using serve::FriendsFile;
using serve::LocationService;
using serve::ServedFriend;
using serve::ServiceMoment;

class LocationServiceTest : public ::testing::Test {
  protected:
    static constexpr ServiceMoment kMoment{0.0, 1700000000123.4};

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
    static Dictionary read(const std::string& text) {
        const auto document = documents::JsonReader::read(text);
        const auto* value = std::get_if<Value>(&document);
        EXPECT_TRUE(value != nullptr && value->dictionary() != nullptr) << text;
        return value != nullptr && value->dictionary() != nullptr ? *value->dictionary() : Dictionary();
    }
    /// The service's answer about Ann, Bo, Cy and somebody unknown, completed.
    std::string locations(const Fault& fault = {}) const {
        Dictionary answer = read(
            R"({"statusCode":200,"serverContext":{"minCallbackIntervalInMS":30000,"callbackTimeoutIntervalInMS":600000,)"
            R"("clientId":"c"},"locations":{"Ann@b.example":{"status":200,"location":{"latitude":51.5,"longitude":-2.5,)"
            R"("horizontalAccuracy":8,"timestamp":1700000000000},"distanceInMeters":"7"}},)"
            R"("emails":["Ann@b.example","+441632960002","cy@b.example","x@y.example"]})");
        service.completeLocations(answer, kMoment, fault);
        return platform::writeJson(answer);
    }
    /// The answer to a command about the user's own sharing, from a service that obeyed it, completed.
    std::string sharing(const std::string& request, bool hidden, const Fault& fault = {}) const {
        Dictionary answer =
            read(R"({"statusCode":200,"serverContext":{},"myInfo":{"preferredEmail":"m@x.example","location":null}})");
        answer.set("myInfo", Dictionary{{"preferredEmail", "m@x.example"}, {"hidden", hidden}, {"location", Value()}});
        service.completeSharing(answer, read(request), kMoment, fault);
        return platform::writeJson(answer);
    }
    bool isHidden() const { return service.sharing().now().hidden; }

    LocationService service{people(), "1000", "token", kMoment.wholeSeconds()};
};

TEST_F(LocationServiceTest, EntriesGetWhatPlacesAreCalled_AndWhoHidesIsNotReported) {
    EXPECT_EQ(
        locations(),
        R"({"statusCode":200,"serverContext":{"minCallbackIntervalInMS":10000,"callbackTimeoutIntervalInMS":600000,)"
        R"("clientId":"c"},"locations":{"Ann@b.example":{"status":200,"location":{"latitude":51.5,"longitude":-2.5,)"
        R"("horizontalAccuracy":8,"timestamp":1700000000000,"streetAddress":"Quay","address":{"locality":"Bristol",)"
        R"("stateCode":"ENG"},"labels":[{"label":"Work"}]},"distanceInMeters":"7"},)"
        R"("cy@b.example":{"status":411,"location":null}},)"
        R"("emails":["Ann@b.example","+441632960002","cy@b.example","x@y.example"]})");
}

TEST_F(LocationServiceTest, Faults_ChangeStatusIntervalAndEntries) {
    Fault partial;
    partial.statusCode = 416;
    EXPECT_EQ(locations(partial).rfind(R"({"statusCode":416,)", 0), 0U);
    EXPECT_NE(locations(partial).find(R"("emails":["Ann@b.example","+441632960002"]})"), std::string::npos);
    EXPECT_EQ(locations(partial).find("cy@b.example"), std::string::npos);
    Fault dropped;
    dropped.entryStatus = 411;
    dropped.entry = "+44 1632 960002";
    dropped.intervalSeconds = 0.0;
    const std::string given = locations(dropped);
    EXPECT_NE(given.find(R"("+441632960002":{"status":411,"location":null})"), std::string::npos) << given;
    EXPECT_NE(given.find(R"("Ann@b.example":{"status":200)"), std::string::npos);
    EXPECT_NE(given.find(R"("minCallbackIntervalInMS":0,)"), std::string::npos);
    dropped.entry = "";
    EXPECT_NE(locations(dropped).find(R"("Ann@b.example":{"status":411,"location":{"latitude":51.5)"),
              std::string::npos);
    EXPECT_EQ(locations(dropped).find(R"("x@y.example":)"), std::string::npos) << "nobody has this handle";
}

TEST_F(LocationServiceTest, PhonesOfThoseWhoAreAskedFor_PostWhereTheyAre_AsAnyPhoneDoes) {
    const auto posts = service.posts({"+441632960001", "Ann@b.example", "cy@b.example", "x@y.example"}, kMoment);
    ASSERT_EQ(posts.size(), 1U) << "one who is found, and once; who hides and who is unknown sends nothing";
    EXPECT_EQ(posts.front().method + " " + posts.front().path, "POST /pub");
    const auto report = server::PhoneMessages::ownTracks(posts.front().body);
    ASSERT_EQ(report.fixes.size(), 1U);
    EXPECT_EQ(report.fixes.front(), (server::RawFix{1700000000.0, 51.5, -2.5, 8.0}));
    EXPECT_EQ(service.posts({}, kMoment).size(), 0U);
}

TEST_F(LocationServiceTest, WaypointThatHides_HidesInTheServiceUntilTheNext_WhereverTheFriendWasBefore) {
    FriendsFile file = people();
    auto& track = file.friends.front().track;
    const auto place = track.front();
    track.insert(track.end(), {place, place});
    track[1].at = 10.0;
    track[1].hidden = true;
    track[2].at = 20.0;
    file.friends.front().repeats = false;
    const LocationService moving{file, "1000", "token", kMoment.wholeSeconds()};
    server::Store& store = *moving.people().store();
    const auto ann = store.personOf("ann@b.example");
    ASSERT_TRUE(ann);
    const auto postsAt = [&](double seconds) {
        return moving.posts({"ann@b.example"}, {seconds, kMoment.millisecondsSince1970 + seconds * 1000.0}).size();
    };
    EXPECT_EQ(postsAt(5.0), 1U);
    EXPECT_FALSE(store.person(*ann)->hidden);
    EXPECT_EQ(postsAt(15.0), 0U);
    EXPECT_TRUE(store.person(*ann)->hidden) << "what was posted before would still be seen";
    EXPECT_EQ(postsAt(25.0), 1U);
    EXPECT_FALSE(store.person(*ann)->hidden);
}

TEST_F(LocationServiceTest, PeopleOfTheFile_ArePeopleOfAService_WhoShareExactlyWithTheUser) {
    server::Store& store = *service.people().store();
    EXPECT_EQ(service.people().complaint(), "");
    const auto ann = store.personOf("Ann@B.example");
    ASSERT_TRUE(ann);
    EXPECT_EQ(store.personOf("+441632960001"), ann);
    const auto sharing = store.sharing(service.people().owner(), *ann);
    ASSERT_TRUE(sharing && sharing->grant);
    EXPECT_EQ(sharing->grant->precision, server::Precision::Exact);
    EXPECT_EQ(sharing->grant->until, std::nullopt);
    bool failed = false;
    const auto reader = store.deviceOf("token", failed);
    ASSERT_TRUE(reader);
    EXPECT_EQ(reader->name, "1000");
    EXPECT_EQ(reader->kind, server::DeviceKind::Reader);
}

TEST_F(LocationServiceTest, HandleOfSeveral_IsTheFirstOnes) {
    FriendsFile file = people();
    file.friends[1].emails = {"ANN@b.example", "bo@b.example", "Bo@b.example"};
    file.friends[2].phones = {"none"};
    file.user.emails = {"ann@b.example", "mara@b.example"};
    const LocationService other(file, "1000", "token", kMoment.wholeSeconds());
    ASSERT_EQ(other.people().complaint(), "");
    server::Store& store = *other.people().store();
    EXPECT_EQ(store.person(store.personOf("ann@b.example").value_or(0))->name, "friend-0");
    EXPECT_EQ(store.personOf("bo@b.example"), store.personOf("+441632960002"));
    EXPECT_EQ(store.person(other.people().owner())->handles, std::vector<std::string>{"mara@b.example"});
}

TEST_F(LocationServiceTest, ShowingTheUser_AnswersWithTheUsersPlace) {
    EXPECT_EQ(
        sharing(
            R"({"clientContext": {"location": {"latitude": 51.5003, "longitude": -2.5, "horizontalAccuracy": 8}}, "prefs": {"hideLocation": "No"}})",
            false),
        R"({"statusCode":200,"serverContext":{"minCallbackIntervalInMS":10000,"callbackTimeoutIntervalInMS":600000},)"
        R"("myInfo":{"preferredEmail":"m@x.example","hidden":false,"location":{"latitude":51.5003,)"
        R"("longitude":-2.5,"horizontalAccuracy":8,"timestamp":1700000000123,"streetAddress":"Quay",)"
        R"("address":{"locality":"Bristol","stateCode":"ENG"},"labels":null}}})");
}

TEST_F(LocationServiceTest, PlaceFarFromEveryStreet_HasItsTownAlone) {
    EXPECT_EQ(service.placeAt(51.51, -2.5).street, std::nullopt);
    EXPECT_EQ(service.placeAt(51.51, -2.5).city, "Bristol");
    EXPECT_EQ(service.placeAt(52.5, -2.5).city, std::nullopt);
}

TEST_F(LocationServiceTest, Hiding_GivesNoPlaceAway_AndThePlaceStaysKnown) {
    const std::string hidden = sharing(
        R"({"clientContext": {"location": {"latitude": 51.5, "longitude": -2.5}}, "prefs": {"hideLocation": "Yes"}})",
        true);
    EXPECT_NE(hidden.find(R"("hidden":true,"location":null)"), std::string::npos) << hidden;
    // What was known before is shown again, also when the client knows no place now.
    const std::string shown = sharing(
        R"({"clientContext": {"location": {"latitude": 0, "longitude": 0, "source": "assistant"}}, "prefs": {"hideLocation": "No"}})",
        false);
    EXPECT_NE(shown.find(R"("hidden":false,"location":{"latitude":51.5,)"), std::string::npos) << shown;
}

TEST_F(LocationServiceTest, ShowingWithoutAPlace_IsNoPlace) {
    const std::string shown = sharing(R"({"clientContext": {}, "prefs": {"hideLocation": "No"}})", false);
    EXPECT_NE(shown.find(R"("location":null)"), std::string::npos) << shown;
}

/// Commands as the service obeys them, by the rules of its store.
class SharingStateTest : public LocationServiceTest {
  protected:
    void command(bool hides) {
        const auto& people = service.people();
        std::promise<bool> done;
        const auto written = [&](bool good) { done.set_value(good); };
        if (hides) {
            people.store()->hide(people.owner(), kMoment.wholeSeconds(), written);
        } else {
            people.store()->shareAsAsked(people.reader(), kMoment.wholeSeconds(), written);
        }
        ASSERT_TRUE(done.get_future().get());
        service.sharing().commanded(hides, std::nullopt);
    }
    void wish(bool hides) {
        const auto& people = service.people();
        ASSERT_TRUE(people.store()->setHidden(people.owner(), hides, kMoment.wholeSeconds()));
        service.sharing().wished(hides);
    }
};

TEST_F(SharingStateTest, WishToBeHidden_IsNotUndoneByACommand) {
    EXPECT_FALSE(isHidden());
    wish(true);
    EXPECT_TRUE(isHidden());
    command(false);
    EXPECT_TRUE(isHidden());
    command(true);
    command(false);
    EXPECT_TRUE(isHidden()) << "a command is no wish";
    wish(false);
    EXPECT_FALSE(isHidden());
}

TEST_F(SharingStateTest, CommandThatHides_IsUndoneByOneThatShows_WhileTheUserWishesToShare) {
    command(true);
    EXPECT_TRUE(isHidden());
    command(false);
    EXPECT_FALSE(isHidden());
}

}  // namespace ktr::test
