// The user's own sharing while it is on screen: controller, refresh controller and command together, over the manual
// clock.
#include "plugin/VAKTRVisibilityController.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using Controller = VAKTRVisibilityController;

class LiveVisibilityTest : public PlatformTest {
  protected:
    LiveVisibilityTest() {
        localization->set("org.ktr.snippets", "HIDDEN_LOCATION", "Hidden");
        localization->set("org.ktr.snippets", "LOCATING", "Locating");
        locationManagers->cached = position(51.5, -2.5);
    }

    void show(bool visible) {
        const auto snippet = std::make_shared<platform::VAKtrVisibilityView>();
        snippet->visible = visible;
        snippet->searchContext = platform::Url(
            "ktrServerContext://serverContext?minCallbackIntervalInMS=5000&callbackTimeoutIntervalInMS=60000&");
        controller = platform::create<Controller>(&Controller::initWithCueObject, snippet);
        controller->setDelegate(host);
        controller->desiredHeightForWidth(375.0);
    }
    static Dictionary myInfo(double latitude) {
        return Dictionary{{"preferredEmail", "mara@example.org"},
                          {"location", Dictionary{{"latitude", latitude}, {"longitude", -2.5}}}};
    }
    void answer(Dictionary body) {
        body.set("serverContext", Dictionary{{"minCallbackIntervalInMS", 10000}});
        transport->answer(std::move(body));
        time->runPosted();
    }
    void walkTo(double latitude) {
        // All managers have one source; the refresh controller's is told before the map's.
        const auto here = position(latitude, -2.5);
        for (const auto& manager : locationManagers->made) {
            manager->cached = here;
        }
        for (const auto& manager : locationManagers->made) {
            manager->deliver(here);
        }
    }
    std::size_t sent() const { return transport->requests.size(); }

    std::shared_ptr<FakeHost> host = std::make_shared<FakeHost>();
    std::shared_ptr<Controller> controller;
};

TEST_F(LiveVisibilityTest, RestingUser_OneCommandThenQuiet_IsKept) {
    show(true);
    time->advance(5.0);
    ASSERT_EQ(sent(), 1U);
    EXPECT_NE(transport->requests[0].path.find("showHideLocation"), std::string::npos);
    answer({{"myInfo", myInfo(51.5)}});
    EXPECT_EQ(controller->myLocation()->friendEmail(), "mara@example.org");
    EXPECT_TRUE(controller->myLocation()->hasCoordinate());
    time->advance(50.0);
    EXPECT_EQ(sent(), 1U);
}

TEST_F(LiveVisibilityTest, MovingUser_IsToldOfEachPlaceUntilTheEnd) {
    show(true);
    time->advance(5.0);
    for (int step = 1; step <= 3; ++step) {
        answer({{"myInfo", myInfo(51.5 + 0.001 * (step - 1))}});
        walkTo(51.5 + 0.001 * step);
        time->advance(10.0);
        ASSERT_EQ(sent(), 1U + static_cast<std::size_t>(step));
    }
    answer({{"myInfo", myInfo(51.503)}});
    walkTo(51.6);
    time->advance(100.0);
    EXPECT_EQ(sent(), 5U) << "one more before the minute was over";
    EXPECT_FALSE(controller->refreshingCancelled());
    EXPECT_FALSE(locationManagers->made.front()->updating);
}

TEST_F(LiveVisibilityTest, RequestBody_ByteForByte) {
    show(true);
    time->advance(5.0);
    ASSERT_EQ(sent(), 1U);
    EXPECT_EQ(transport->requests[0].body,
              R"({"clientContext":{"deviceUDID":"device-1","productType":"Model 7","osVersion":"12.5",)"
              R"("buildVersion":"6.1.0-18","locale":"en-GB","countryCode":"CH","regionCode":"GB",)"
              R"("location":{"latitude":51.5,"longitude":-2.5,"source":"assistant","horizontalAccuracy":10,)"
              R"("timestamp":1768478400000}},"prefs":{"hideLocation":"No"}})");
}

TEST_F(LiveVisibilityTest, MapFollowsTheUser) {
    show(true);
    walkTo(51.6);
    ASSERT_TRUE(controller->mapView()->mapView()->requestedRegion().has_value());
    EXPECT_EQ(controller->mapView()->mapView()->requestedRegion()->center.latitude, 51.6);
}

TEST_F(LiveVisibilityTest, HiddenUser_AsksWhereTheUserIs_FromWhereTheyAre_AndShowsThemToNobody_IsKept) {
    show(false);
    time->advance(5.0);
    ASSERT_EQ(sent(), 1U);
    EXPECT_NE(transport->requests[0].path.find("getlocations"), std::string::npos);
    EXPECT_NE(transport->requests[0].body.find(R"("handles":["ann@example.org"])"), std::string::npos)
        << transport->requests[0].body;
    // What is asked near whom goes along, as with any friend; nothing asks to be shown.
    EXPECT_NE(transport->requests[0].body.find(R"("myLocation":{"latitude":51.5,"longitude":-2.5)"), std::string::npos)
        << transport->requests[0].body;
    EXPECT_EQ(transport->requests[0].body.find("hideLocation"), std::string::npos);
    answer({{"locations", Dictionary{}}});
    walkTo(51.6);
    time->advance(1000.0);
    for (const auto& request : transport->requests) {
        EXPECT_EQ(request.path.find("showHideLocation"), std::string::npos);
    }
    EXPECT_EQ(controller->friendView()->locationLabel()->text(), "Hidden");
}

TEST_F(LiveVisibilityTest, AnswerWithoutMyInfo_IsTheUserWithoutAPlace) {
    show(true);
    time->advance(5.0);
    answer({});
    ASSERT_NE(controller->myLocation(), nullptr);
    EXPECT_EQ(controller->myLocation()->friendEmail(), "ann@example.org");
    EXPECT_FALSE(controller->myLocation()->hasCoordinate());
    EXPECT_EQ(controller->friendView()->locationLabel()->text(), "Locating");
    EXPECT_EQ(controller->friendView()->nameLabel()->text(), "ann@example.org");
}

TEST_F(LiveVisibilityTest, AnswerWithoutABody_LeavesARowOfNobody) {
    show(true);
    time->advance(5.0);
    transport->answer({platform::HttpFailure::None, 200, std::nullopt, {}});
    time->runPosted();
    EXPECT_GT(controller->desiredHeightForWidth(375.0), 219.0);
    controller->view()->layoutIfNeeded();
    time->advance(100.0);
    EXPECT_EQ(sent(), 1U);
}

TEST_F(LiveVisibilityTest, Searching_UntilThePlaceIsKnownOrRefreshingEnds) {
    show(true);
    EXPECT_TRUE(controller->isSearching());
    time->advance(5.0);
    answer({});
    EXPECT_TRUE(controller->isSearching()) << "no place yet";
    time->advance(55.0);
    EXPECT_FALSE(controller->isSearching());
    show(true);
    time->advance(5.0);
    answer({{"myInfo", myInfo(51.5)}});
    EXPECT_FALSE(controller->isSearching());
    show(false);
    EXPECT_FALSE(controller->isSearching());
}

TEST_F(LiveVisibilityTest, LogLines) {
    show(true);
    time->advance(5.0);
    answer({{"myInfo", myInfo(51.5)}});
    for (const auto* line : {"is visible init called: 1", "Sending visibility refresh command",
                             "visibility_vela_location: <KTRVAMyLocation visible>"}) {
        EXPECT_TRUE(log->has(platform::LogLevel::Default, line)) << line;
    }
}

TEST_F(LiveVisibilityTest, Teardown_WithACommandUnderWay) {
    show(true);
    time->advance(5.0);
    controller.reset();
    answer({{"myInfo", myInfo(51.5)}});
    time->advance(1000.0);
    EXPECT_EQ(sent(), 1U);
    EXPECT_EQ(time->pendingTimers(), 0U);
}

}  // namespace
}  // namespace ktr::test
