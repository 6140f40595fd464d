#include "service/RefreshController.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;
using platform::LogLevel;

/// Writes down what it hears.
class Delegate : public platform::Object, public RefreshControllerDelegate {
  public:
    std::optional<std::string> clientId() const override { return client; }
    std::vector<std::shared_ptr<platform::VAPerson>> friends() const override { return {}; }
    std::optional<std::string> proximity() const override { return near; }
    void locationsUpdated(const std::shared_ptr<const ServiceResult>& result) override {
        ASSERT_NE(result, nullptr);
        heard.push_back("updated " + std::to_string(result->size()));
    }
    void refreshCancelled() override { heard.emplace_back("cancelled"); }

    std::optional<std::string> client = "client-1";
    std::optional<std::string> near;
    std::vector<std::string> heard;
};

using Heard = std::vector<std::string>;

class RefreshControllerPollingTest : public PlatformTest {
  protected:
    RefreshControllerPollingTest() { controller->setDelegate(delegate); }

    void answer(double seconds) {
        transport->answer(Dictionary{{"serverContext", Dictionary{{"minCallbackIntervalInMS", seconds * 1000.0}}},
                                     {"locations", Dictionary{{"a@x", Dictionary{}}}}});
    }
    void answerNow(double seconds) {
        answer(seconds);
        time->runPosted();
    }
    std::size_t sent() const { return transport->requests.size(); }

    std::shared_ptr<Delegate> delegate = std::make_shared<Delegate>();
    std::shared_ptr<RefreshController> controller =
        platform::create<RefreshController>(&RefreshController::initWithBundle, nullptr);
};

TEST_F(RefreshControllerPollingTest, NothingIsSentBeforeTheStart) {
    time->advance(1000.0);
    EXPECT_EQ(sent(), 0U);
    EXPECT_EQ(controller->pollTimer(), nullptr);
    EXPECT_EQ(controller->timeout(), 0.0);
    EXPECT_FALSE(controller->refresherCancelled());
}

TEST_F(RefreshControllerPollingTest, ServiceSetsThePace) {
    controller->beginTimerWithRefresh(5.0, 100.0);
    time->advance(4.9);
    EXPECT_EQ(sent(), 0U);
    time->advance(0.1);
    ASSERT_EQ(sent(), 1U);
    answerNow(20.0);
    EXPECT_EQ(delegate->heard, Heard{"updated 1"});
    EXPECT_EQ(controller->pollTimer()->interval(), 20.0);
    time->advance(19.9);
    EXPECT_EQ(sent(), 1U);
    time->advance(0.1);
    EXPECT_EQ(sent(), 2U);
}

TEST_F(RefreshControllerPollingTest, CommandIsFilledFromDelegateAndPosition) {
    delegate->near = "near";
    locationManagers->made.back()->deliver(position(51.5, -0.25, 0.0));
    controller->refreshLocations();
    ASSERT_EQ(sent(), 1U);
    const auto& request = transport->requests[0];
    EXPECT_EQ(request.path, "/qloxservice/friends/va/getlocations");
    EXPECT_NE(request.body.find(R"("handles":[],"myLocation":{"latitude":51.5,"longitude":-0.25,)"), std::string::npos);
    EXPECT_TRUE(request.body.ends_with(R"("requestedLocation":{"latitude":0,"longitude":0,"source":"assistant"},)"
                                       R"("proximity":"near","serverContext":{"clientId":"client-1"}})"))
        << request.body;
}

TEST_F(RefreshControllerPollingTest, WithoutDelegate_ACommandIsSentAllTheSame) {
    controller->setDelegate({});
    controller->refreshLocations();
    ASSERT_EQ(sent(), 1U);
    EXPECT_EQ(transport->requests[0].body.find("handles"), std::string::npos);
    answerNow(5.0);
    EXPECT_TRUE(delegate->heard.empty());
}

TEST_F(RefreshControllerPollingTest, LogsWhatItDoes) {
    controller->beginTimerWithRefresh(2.5, 3.5);
    time->advance(2.5);
    const auto lines = log->texts(LogLevel::Default);
    const std::vector<std::string> expected = {
        "Begining timerWithRefresh: 2 timeout:4",
        "Rescheduling timer with refresh in: 2 seconds",
        "Refreshing friend location.",
        "Sending location refresh command",
    };
    ASSERT_GE(lines.size(), expected.size());
    EXPECT_EQ(std::vector<std::string>(lines.begin(), lines.begin() + 4), expected);
}

TEST_F(RefreshControllerPollingTest, ZeroTimeout_OneRequestOneAnswerOneEnd) {
    controller->beginTimerWithRefresh(5.0, 0.0);
    EXPECT_TRUE(controller->refresherCancelled());
    time->advance(5.0);
    ASSERT_EQ(sent(), 1U);
    answerNow(10.0);
    EXPECT_EQ(delegate->heard, (Heard{"updated 1", "cancelled"}));
    EXPECT_TRUE(
        log->has(LogLevel::Default, "timeout is 0, informing the delegate of cancellation after first callback"));
    EXPECT_EQ(time->pendingTimers(), 0U);
    time->advance(1000.0);
    EXPECT_EQ(sent(), 1U);
    EXPECT_EQ(delegate->heard.size(), 2U);
}

TEST_F(RefreshControllerPollingTest, NegativeTimeout_IsStoredAsZero) {
    controller->beginTimerWithRefresh(5.0, -1.0);
    EXPECT_EQ(controller->timeout(), 0.0);
    EXPECT_TRUE(controller->refresherCancelled());
}

TEST_F(RefreshControllerPollingTest, RefreshOfZeroOrLess_FiresOnALaterTurn) {
    controller->beginTimerWithRefresh(-3.0, 10.0);
    EXPECT_EQ(sent(), 0U);
    time->advance(0.0);
    EXPECT_EQ(sent(), 1U);
}

TEST_F(RefreshControllerPollingTest, NoStart_AnAnswerIsReportedAsTheEnd_IsKept) {
    controller->refreshLocations();
    answerNow(10.0);
    EXPECT_EQ(delegate->heard, (Heard{"updated 1", "cancelled"}));
    // Nothing cancelled it, so that the service's interval still counts.
    EXPECT_EQ(time->pendingTimers(), 1U);
}

TEST_F(RefreshControllerPollingTest, IntervalOfZeroOrLess_EndsPollingButDelivers) {
    for (const double interval : {0.0, -5.0}) {
        delegate->heard.clear();
        controller->setTimeout(100.0);
        controller->refreshLocations();
        answerNow(interval);
        EXPECT_EQ(delegate->heard, Heard{"updated 1"});
        EXPECT_EQ(time->pendingTimers(), 0U);
    }
}

TEST_F(RefreshControllerPollingTest, FailedRefresh_EndsPollingSilently_IsKept) {
    controller->beginTimerWithRefresh(1.0, 100.0);
    time->advance(1.0);
    transport->fail(platform::HttpFailure::Timeout);
    time->runPosted();
    time->advance(98.0);
    EXPECT_TRUE(delegate->heard.empty());
    EXPECT_EQ(sent(), 1U);
    EXPECT_FALSE(controller->refresherCancelled());
    time->advance(1.0);
    EXPECT_EQ(delegate->heard, Heard{"cancelled"});
    EXPECT_TRUE(controller->refresherCancelled());
}

TEST_F(RefreshControllerPollingTest, FailedRefresh_ANewStartPollsAgain) {
    controller->beginTimerWithRefresh(1.0, 100.0);
    time->advance(1.0);
    transport->fail(platform::HttpFailure::Network);
    time->runPosted();
    controller->beginTimerWithRefresh(1.0, 100.0);
    time->advance(1.0);
    EXPECT_EQ(sent(), 2U);
    answerNow(3.0);
    EXPECT_EQ(controller->pollTimer()->interval(), 3.0);
}

TEST_F(RefreshControllerPollingTest, TwoStarts_LeadToTwoRefreshes_IsKept) {
    controller->beginTimerWithRefresh(5.0, 100.0);
    const auto first = controller->pollTimer();
    time->advance(1.0);
    controller->beginTimerWithRefresh(5.0, 100.0);
    EXPECT_TRUE(first->isValid());
    EXPECT_NE(controller->pollTimer(), first);
    time->advance(4.0);
    EXPECT_EQ(sent(), 1U);
    time->advance(1.0);
    EXPECT_EQ(sent(), 2U);
}

TEST_F(RefreshControllerPollingTest, CancelTimer_StopsOnlyTheLastTimer_IsKept) {
    controller->beginTimerWithRefresh(5.0, 100.0);
    controller->beginTimerWithRefresh(5.0, 100.0);
    controller->cancelTimer();
    time->advance(5.0);
    EXPECT_EQ(sent(), 1U);
}

TEST_F(RefreshControllerPollingTest, DelayedCancelIsNotWithdrawn_IsKept) {
    controller->beginTimerWithRefresh(50.0, 20.0);
    time->advance(1.0);
    controller->cancelTimer();
    EXPECT_EQ(delegate->heard, Heard{"cancelled"});
    time->advance(19.0);
    EXPECT_EQ(delegate->heard, (Heard{"cancelled", "cancelled"}));
}

TEST_F(RefreshControllerPollingTest, EveryStartCancelsAtItsOwnTime_IsKept) {
    controller->beginTimerWithRefresh(50.0, 20.0);
    time->advance(5.0);
    controller->beginTimerWithRefresh(50.0, 20.0);
    time->advance(100.0);
    EXPECT_EQ(delegate->heard, (Heard{"cancelled", "cancelled"}));
}

TEST_F(RefreshControllerPollingTest, CancelTimer_TellsBeforeItStops) {
    struct Watching : Delegate {
        RefreshController* controller = nullptr;
        FakeLocationManager* manager = nullptr;
        bool checked = false;
        void refreshCancelled() override {
            checked = controller->refresherCancelled() && controller->pollTimer()->isValid() && manager->updating;
        }
    };
    const auto watching = std::make_shared<Watching>();
    watching->controller = controller.get();
    watching->manager = locationManagers->made.back().get();
    controller->setDelegate(watching);
    controller->beginTimerWithRefresh(5.0, 100.0);
    controller->cancelTimer();
    EXPECT_TRUE(watching->checked);
    EXPECT_FALSE(controller->pollTimer()->isValid());
    EXPECT_FALSE(watching->manager->updating);
    EXPECT_TRUE(log->has(LogLevel::Default, "Cancelling_Timer"));
    controller->setDelegate({});
}

TEST_F(RefreshControllerPollingTest, AfterCancel_AStartGetsOneAnswerAndNoMore_IsKept) {
    controller->cancelTimer();
    controller->beginTimerWithRefresh(1.0, 100.0);
    time->advance(1.0);
    EXPECT_EQ(sent(), 1U);
    answerNow(2.0);
    EXPECT_EQ(delegate->heard, (Heard{"cancelled", "updated 1"}));
    time->advance(50.0);
    EXPECT_EQ(sent(), 1U);
    EXPECT_TRUE(controller->refresherCancelled());
}

TEST_F(RefreshControllerPollingTest, AnswerAfterCancel_IsDeliveredAndArmsNothing) {
    controller->beginTimerWithRefresh(1.0, 100.0);
    time->advance(1.0);
    controller->cancelTimer();
    answerNow(2.0);
    EXPECT_EQ(delegate->heard, (Heard{"cancelled", "updated 1"}));
    // The delayed cancel alone is left.
    EXPECT_EQ(time->pendingTimers(), 1U);
}

TEST_F(RefreshControllerPollingTest, NewTimerIsArmedBeforeTheDelegateHears) {
    controller->beginTimerWithRefresh(1.0, 100.0);
    time->advance(1.0);
    struct Watching : Delegate {
        RefreshController* controller = nullptr;
        double interval = 0.0;
        void locationsUpdated(const std::shared_ptr<const ServiceResult>&) override {
            interval = controller->pollTimer()->interval();
        }
    };
    const auto watching = std::make_shared<Watching>();
    watching->controller = controller.get();
    controller->setDelegate(watching);
    answerNow(7.0);
    EXPECT_EQ(watching->interval, 7.0);
    controller->setDelegate({});
}

TEST_F(RefreshControllerPollingTest, AnswerIsHandledOnALaterTurn) {
    controller->refreshLocations();
    answer(5.0);
    EXPECT_TRUE(delegate->heard.empty());
    time->runPosted();
    EXPECT_FALSE(delegate->heard.empty());
}

TEST_F(RefreshControllerPollingTest, RequestUnderWayIsCompletedThoughTheSnippetIsGone) {
    controller->beginTimerWithRefresh(1.0, 100.0);
    time->advance(1.0);
    const std::weak_ptr<RefreshController> watched = controller;
    controller.reset();
    EXPECT_FALSE(watched.expired());
    answerNow(0.0);
    EXPECT_TRUE(watched.expired());
    EXPECT_EQ(delegate->heard, (Heard{"updated 1", "cancelled"}));
}

TEST_F(RefreshControllerPollingTest, FailedRequestLetsTheControllerGo) {
    controller->refreshLocations();
    const std::weak_ptr<RefreshController> watched = controller;
    controller.reset();
    transport->fail(platform::HttpFailure::Tls);
    EXPECT_FALSE(watched.expired());
    time->runPosted();
    EXPECT_TRUE(watched.expired());
}

TEST_F(RefreshControllerPollingTest, Timers_DoNotKeepTheController) {
    controller->beginTimerWithRefresh(5.0, 100.0);
    const std::weak_ptr<RefreshController> watched = controller;
    controller.reset();
    EXPECT_TRUE(watched.expired());
    time->advance(1000.0);
    EXPECT_EQ(sent(), 0U);
    EXPECT_EQ(time->pendingTimers(), 0U);
}

TEST_F(RefreshControllerPollingTest, Teardown_IsHeardAndStopsUpdatesTwice) {
    const auto manager = locationManagers->made.back();
    controller->beginTimerWithRefresh(5.0, 100.0);
    const auto timer = controller->pollTimer();
    controller.reset();
    EXPECT_EQ(delegate->heard, Heard{"cancelled"});
    EXPECT_FALSE(timer->isValid());
    EXPECT_EQ(manager->stops, 2);
}

TEST_F(RefreshControllerPollingTest, TransportGoesAway_NothingIsLeft) {
    controller->refreshLocations();
    const std::weak_ptr<RefreshController> watched = controller;
    controller.reset();
    platform->httpTransport = nullptr;
    transport.reset();
    time->runPosted();
    EXPECT_TRUE(watched.expired());
}

}  // namespace
}  // namespace ktr::test
