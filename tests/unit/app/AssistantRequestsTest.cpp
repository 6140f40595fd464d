// Questions that ask for something: fences, and the user's own sharing.
#include <gtest/gtest.h>

#include "host/scenario/ScenarioReader.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Json.h"
#include "serve/AssistantAnswers.h"
#include "serve/FriendsReader.h"

namespace ktr::test {

using serve::AssistantAnswers;
using serve::LocationService;

class AssistantRequestsTest : public ::testing::Test {
  protected:
    static LocationService people() {
        auto read = serve::FriendsReader::readText(R"({"intervalSeconds": 5, "friends": [
            {"fullName": "Ann Marsh", "firstName": "Ann", "lastName": "Marsh", "emails": "ann@b.example",
             "track": [{"at": 0, "latitude": 51.5, "longitude": -2.5, "street": "Quay Road"},
                       {"at": 10, "latitude": 51.51, "longitude": -2.51, "street": "Salt Lane", "label": "Work"},
                       {"at": 20, "latitude": 51.52, "longitude": -2.52, "label": "Home"}]},
            {"fullName": "Otto Brandt", "firstName": "Otto", "lastName": "Brandt", "emails": "otto@b.example",
             "track": [{"latitude": 51.6, "longitude": -2.6, "label": "Fish Market"}]},
            {"fullName": "Shirin", "firstName": "Shirin", "phones": "+44 1", "hidden": true}]})",
                                                   "f.json");
        return {std::get<serve::FriendsFile>(read), "1000", "token", 1700000000};
    }
    platform::Dictionary answer(const std::string& question) const {
        return AssistantAnswers(service).answer(question, {0.0, 1.7e12});
    }
    /// What the window would make of the answer.
    host::Scenario scenario(const std::string& question) const {
        const auto read =
            host::ScenarioReader(platform::Date{0.0}).readText(platform::writeJson(answer(question)), "answer");
        const auto* error = std::get_if<documents::DocumentError>(&read);
        EXPECT_EQ(error, nullptr) << error->text();
        return error != nullptr ? host::Scenario() : std::get<host::Scenario>(read);
    }
    /// "trigger label street latitude" of the fence; "-" without one.
    std::string fence(const std::string& question) const {
        const auto snippet = std::dynamic_pointer_cast<platform::VAKtrGeoFenceSnippet>(scenario(question).snippet);
        if (!snippet) {
            return "-";
        }
        const auto& place = *snippet->cueKtrGeoFence->location;
        EXPECT_EQ(place.accuracy, 100.0);
        return snippet->cueKtrGeoFence->geoFenceTrigger.value_or("none") + " " + place.label.value_or("none") + " " +
               place.street.value_or("none") + " " + std::to_string(place.latitude.value_or(0.0)).substr(0, 5);
    }
    /// "seen", "hidden", or "-" when the answer is about something else; then what the service keeps.
    std::string sharing(const std::string& question) const {
        const auto view = std::dynamic_pointer_cast<platform::VAKtrVisibilityView>(scenario(question).snippet);
        const std::string kept = service.sharing().now().hidden ? " hidden" : " seen";
        return (!view ? "-" : view->visible ? "seen" : "hidden") + kept;
    }
    LocationService service = people();
};

TEST_F(AssistantRequestsTest, Leaving) {
    for (const char* question :
         {"Tell me when Ann leaves work", "tell me when ann marsh leaves the work.", "Let me know once Ann leaves work",
          "Notify me when ann@b.example leaves work", "When Ann leaves work, tell me", "Notify me of Ann leaving work",
          "Tell me as soon as Ann gets out of work", "alert me if Ann departs from work for home",
          "Tell me when Ann has left work", "Remind me when Ann goes off work"}) {
        EXPECT_EQ(fence(question), "OnDeparture _$!<work>!$_ Salt Lane 51.51") << question;
    }
}

TEST_F(AssistantRequestsTest, Arriving) {
    for (const char* question :
         {"Tell me when Ann gets home", "Tell me when Ann gets home from work", "let me know when ann arrives at home",
          "Notify me once Ann comes back home", "Tell me if Ann is at home", "tell me when Ann goes home after work",
          "Please inform me as soon as Ann reaches home today"}) {
        EXPECT_EQ(fence(question), "OnArrival _$!<home>!$_ none 51.52") << question;
    }
}

TEST_F(AssistantRequestsTest, PlacesByTheirNameOrStreet) {
    EXPECT_EQ(fence("Tell me when Ann arrives at the Fish Market"), "OnArrival Fish Market none 51.60");
    EXPECT_EQ(fence("tell me when Otto leaves the fish market"), "OnDeparture Fish Market none 51.60");
    EXPECT_EQ(fence("Tell me when Otto gets to Quay Road"), "OnArrival none Quay Road 51.50");
}

TEST_F(AssistantRequestsTest, WithoutAPlace_WhereTheFriendIs) {
    EXPECT_EQ(fence("Tell me when Ann leaves"), "OnDeparture none none 51.50");
    EXPECT_EQ(fence("Tell me when Ann goes out"), "OnDeparture none none 51.50");
    EXPECT_EQ(fence("Tell me when Otto arrives"), "OnArrival none none 51.60");
}

TEST_F(AssistantRequestsTest, Here_IsWhereTheUserIs) {
    EXPECT_EQ(fence("Tell me when Ann gets here"), "-");
    service.sharing().commanded(false, serve::SharingState::Position{51.51, -2.51});
    EXPECT_EQ(fence("Tell me when Ann gets here"), "OnArrival none Salt Lane 51.51");
}

TEST_F(AssistantRequestsTest, AtOnce) {
    EXPECT_EQ(fence("Notify me where Ann is right now"), "Immediate none none 51.50");
    EXPECT_EQ(fence("Let me know about Otto at once"), "Immediate none none 51.60");
}

TEST_F(AssistantRequestsTest, NoFence) {
    for (const char* question :
         {"Tell me where Ann is now", "Where is Ann leaving to?", "Tell me when the train leaves work",
          "Tell me when Ann gets to the moon", "Tell me when Otto gets home", "Tell me when Shirin leaves",
          "Tell me when Ann and Otto leave work", "Remind me to leave", "Tell me when Ann is happy"}) {
        EXPECT_EQ(fence(question), "-") << question;
        EXPECT_FALSE(scenario(question).sentence.text("en").empty()) << question;
    }
    EXPECT_NE(scenario("Tell me where Ann is now").snippet, nullptr) << "she is shown";
}

TEST_F(AssistantRequestsTest, FenceSnippet_SaysWhoAndHowFarToZoom) {
    const auto turn = scenario("Tell me when Ann leaves work");
    EXPECT_EQ(turn.sentence.text("en"), "I will tell you when Ann Marsh leaves.");
    const auto snippet = std::dynamic_pointer_cast<platform::VAKtrGeoFenceSnippet>(turn.snippet);
    ASSERT_NE(snippet, nullptr);
    EXPECT_EQ(snippet->cueKtrGeoFence->friend_->data, "ann@b.example");
    EXPECT_EQ(snippet->searchContext->text(),
              "ktrServerContext://serverContext?clientId=ktr-serve&minCallbackIntervalInMS=5000&"
              "callbackTimeoutIntervalInMS=600000&geoFenceZoomLevel=0.00225&");
}

TEST_F(AssistantRequestsTest, Hiding) {
    for (const char* question :
         {"Hide my location", "hide me", "Please stop sharing my location", "Don't share where I am",
          "Don\xE2\x80\x99t let my friends see me", "Make me invisible", "Can you hide my location?",
          "Hide my location from Ann", "Stop showing my location", "Never share my location"}) {
        service.sharing().wish(false, 1700000000);
        EXPECT_EQ(sharing(question), "hidden hidden") << question;
    }
}

TEST_F(AssistantRequestsTest, Showing) {
    for (const char* question :
         {"Share my location", "Show my location", "show my position to my friends", "Let my friends see me",
          "Stop hiding me", "Unhide me", "Make me visible", "share my location with Ann and Otto",
          "Could you share where I am?", "Let everybody see where I am"}) {
        service.sharing().wish(true, 1700000000);
        EXPECT_EQ(sharing(question), "seen seen") << question;
    }
}

TEST_F(AssistantRequestsTest, AskingChangesNothing) {
    for (const char* question : {"Am I hidden?", "Can my friends see me?", "Is my location shared?", "Who can see me?",
                                 "Do my friends see where I am?", "Am I sharing my location?"}) {
        service.sharing().wish(true, 1700000000);
        EXPECT_EQ(sharing(question), "hidden hidden") << question;
        service.sharing().wish(false, 1700000000);
        EXPECT_EQ(sharing(question), "seen seen") << question;
    }
}

TEST_F(AssistantRequestsTest, WhatIsInDoubt_ShowsNobody) {
    service.sharing().wish(true, 1700000000);
    for (const char* question : {"Show me where I am", "Where am I?", "Show me my friends", "Is Ann sharing with me?",
                                 "Where is Ann hiding?", "Share a joke", "Find me a restaurant", "Show me Ann"}) {
        EXPECT_EQ(sharing(question), "- hidden") << question;
    }
}

TEST_F(AssistantRequestsTest, SharingSnippet_NamesTheUser) {
    const auto turn = scenario("Hide my location");
    EXPECT_EQ(turn.sentence.text("en"), "Done. Friends can\xE2\x80\x99t see where you are.");
    EXPECT_EQ(turn.kind, "VAKtrVisibilityView");
    const auto view = std::dynamic_pointer_cast<platform::VASnippet>(turn.snippet);
    EXPECT_TRUE(view->searchContext->text().ends_with("&preferredEmail=mara.lind@harbour.example&"));
    EXPECT_EQ(scenario("Am I hidden?").sentence.text("en"), "Friends can\xE2\x80\x99t see where you are.");
}

}  // namespace ktr::test
