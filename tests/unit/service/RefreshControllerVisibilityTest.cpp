// The refresh controller of the snippet about the user's own sharing.
#include "model/KTRVAMyLocation.h"
#include "service/RefreshController.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::LogLevel;

/// Keeps what it hears.
class Delegate : public platform::Object, public RefreshControllerDelegate {
  public:
    std::optional<std::string> clientId() const override { return "client-1"; }
    std::vector<std::shared_ptr<platform::VAPerson>> friends() const override { return {}; }
    std::optional<std::string> proximity() const override { return std::nullopt; }
    void locationsUpdated(const std::shared_ptr<const ServiceResult>& result) override { results.push_back(result); }
    void refreshCancelled() override { ++cancelled; }

    std::vector<std::shared_ptr<const ServiceResult>> results;
    int cancelled = 0;
};

class RefreshControllerVisibilityTest : public PlatformTest {
  protected:
    static constexpr const char* kSkipping = "Skipping visibility refresh, current location hasn't changed";

    RefreshControllerVisibilityTest() {
        controller->setDelegate(delegate);
        controller->setIsVisibilityRefresh(true);
        controller->setCurrentLocation(position(51.5, -2.5));
    }
    void answerNow(double seconds) {
        transport->answer(Dictionary{{"serverContext", Dictionary{{"minCallbackIntervalInMS", seconds * 1000.0}}},
                                     {"myInfo", Dictionary{}}});
        time->runPosted();
    }
    std::size_t sent() const { return transport->requests.size(); }
    /// A command lives until its completion has run: dropping the request would keep it for ever.
    void cancelWaiting() {
        while (!transport->waiting.empty()) {
            transport->fail(platform::HttpFailure::Cancelled);
        }
        time->runPosted();
    }

    std::shared_ptr<Delegate> delegate = std::make_shared<Delegate>();
    std::shared_ptr<RefreshController> controller =
        platform::create<RefreshController>(&RefreshController::initWithBundle, nullptr);
};

TEST_F(RefreshControllerVisibilityTest, Default_IsFriendsRefreshing) {
    const auto fresh = platform::create<RefreshController>(&RefreshController::initWithBundle, nullptr);
    EXPECT_FALSE(fresh->isVisibilityRefresh());
    EXPECT_EQ(fresh->lastRefreshLocation(), nullptr);
}

TEST_F(RefreshControllerVisibilityTest, Tick_SendsShowCommandAtThePresentPosition) {
    log->clear();
    controller->beginTimerWithRefresh(5.0, 100.0);
    time->advance(5.0);
    ASSERT_EQ(sent(), 1U);
    EXPECT_NE(transport->requests[0].path.find("/qloxservice/friends/va/showHideLocation"), std::string::npos);
    EXPECT_NE(transport->requests[0].body.find(R"("location":{"latitude":51.5,"longitude":-2.5,)"), std::string::npos);
    EXPECT_TRUE(transport->requests[0].body.ends_with(R"("prefs":{"hideLocation":"No"}})"));
    EXPECT_TRUE(log->has(LogLevel::Default, "Sending visibility refresh command"));
    EXPECT_FALSE(log->has(LogLevel::Default, "Refreshing friend location."));
    answerNow(10.0);
    ASSERT_EQ(delegate->results.size(), 1U);
    ASSERT_EQ(delegate->results[0]->size(), 2U);
    EXPECT_TRUE(std::get<std::shared_ptr<KTRVAMyLocation>>(delegate->results[0]->back())->isVisible());
    EXPECT_EQ(controller->pollTimer()->interval(), 10.0);
}

TEST_F(RefreshControllerVisibilityTest, RestingUser_OneCommandThenQuiet_IsKept) {
    controller->beginTimerWithRefresh(5.0, 1000.0);
    time->advance(5.0);
    answerNow(10.0);
    time->advance(900.0);
    EXPECT_EQ(sent(), 1U);
    EXPECT_TRUE(log->has(LogLevel::Default, kSkipping));
    EXPECT_EQ(delegate->cancelled, 0) << "the end is not told";
    EXPECT_FALSE(controller->refresherCancelled());
}

TEST_F(RefreshControllerVisibilityTest, MovingUser_IsToldOfEachPlace) {
    controller->beginTimerWithRefresh(5.0, 1000.0);
    time->advance(5.0);
    for (int step = 1; step <= 3; ++step) {
        answerNow(10.0);
        controller->setCurrentLocation(position(51.5 + 0.001 * step, -2.5));
        time->advance(10.0);
        EXPECT_EQ(sent(), 1U + static_cast<std::size_t>(step));
    }
}

TEST_F(RefreshControllerVisibilityTest, AMillionthOfADegree_IsNoMove) {
    for (const auto& [latitude, longitude, commands] :
         {std::tuple{51.5 + 9e-7, -2.5 - 9e-7, 1U}, std::tuple{51.5 + 2e-6, -2.5, 2U},
          std::tuple{51.5, -2.5 + 2e-6, 2U}}) {
        cancelWaiting();
        transport->requests.clear();
        controller->setLastRefreshLocation(nullptr);
        controller->setCurrentLocation(position(51.5, -2.5));
        controller->refreshVisibility();
        controller->setCurrentLocation(position(latitude, longitude));
        controller->refreshVisibility();
        EXPECT_EQ(sent(), commands) << latitude << " " << longitude;
    }
}

TEST_F(RefreshControllerVisibilityTest, ExactlyTheThreshold_IsNoMove) {
    // From 0, so that the difference is the threshold to the last bit.
    controller->setCurrentLocation(position(0.0, 0.0));
    controller->refreshVisibility();
    controller->setCurrentLocation(position(1e-6, -1e-6));
    controller->refreshVisibility();
    EXPECT_EQ(sent(), 1U);
}

TEST_F(RefreshControllerVisibilityTest, FailedCommand_CountsAsSent_IsKept) {
    controller->refreshVisibility();
    transport->fail(platform::HttpFailure::Network);
    time->runPosted();
    EXPECT_NE(controller->lastRefreshLocation(), nullptr);
    controller->refreshVisibility();
    EXPECT_EQ(sent(), 1U);
    EXPECT_TRUE(delegate->results.empty());
}

TEST_F(RefreshControllerVisibilityTest, UnknownPosition_IsSentEachTime) {
    controller->setCurrentLocation(nullptr);
    controller->refreshVisibility();
    controller->refreshVisibility();
    EXPECT_EQ(sent(), 2U);
    EXPECT_NE(transport->requests[0].body.find(R"("location":{"latitude":0,"longitude":0,"source":"assistant"}})"),
              std::string::npos);
}

TEST_F(RefreshControllerVisibilityTest, PositionLost_ComparesAsZero) {
    controller->refreshVisibility();
    controller->setCurrentLocation(nullptr);
    controller->refreshVisibility();
    EXPECT_EQ(sent(), 2U);
}

TEST_F(RefreshControllerVisibilityTest, Change_TakesEffectAtTheNextTick) {
    controller->beginTimerWithRefresh(5.0, 100.0);
    controller->setIsVisibilityRefresh(false);
    time->advance(5.0);
    ASSERT_EQ(sent(), 1U);
    EXPECT_NE(transport->requests[0].path.find("getlocations"), std::string::npos);
    EXPECT_EQ(controller->lastRefreshLocation(), nullptr);
}

TEST_F(RefreshControllerVisibilityTest, AnswerWithoutABody_IsAnEmptyResultAndTheEnd) {
    controller->beginTimerWithRefresh(5.0, 100.0);
    time->advance(5.0);
    transport->answer({platform::HttpFailure::None, 200, std::nullopt, {}});
    time->runPosted();
    for (const auto& result : delegate->results) {
        EXPECT_TRUE(result->empty());
    }
    time->advance(90.0);
    EXPECT_EQ(sent(), 1U);
}

}  // namespace
}  // namespace ktr::test
