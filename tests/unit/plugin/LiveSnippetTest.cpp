// A snippet that refreshes: controller, refresh controller and commands together, over the manual clock.
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>

namespace ktr::test {
namespace {

using platform::Dictionary;
using Controller = VAKTRMultipleLocationsSnippetController;

class LiveSnippetTest : public PlatformTest {
  protected:
    LiveSnippetTest() {
        localization->set("org.ktr.snippets", "LOCATING_FRIENDS", "Locating");
        localization->set("org.ktr.snippets", "NO_FRIENDS_FOUND", "None found");
    }

    void make(const std::optional<std::string>& context, platform::LocationList locations) {
        controller = platform::create<Controller>(&Controller::initWithCueObject,
                                                  proximitySnippet(std::move(locations), context));
        controller->setDelegate(host);
    }
    void makePolling() {
        make("clientId=c-1&minCallbackIntervalInMS=5000&callbackTimeoutIntervalInMS=60000&",
             {friendByEmail("Ann", "ann@example.org")});
    }
    void answer(double latitude, double seconds) {
        transport->answer(Dictionary{
            {"serverContext", Dictionary{{"minCallbackIntervalInMS", seconds * 1000.0}}},
            {"locations", Dictionary{{"ann@example.org", Dictionary{{"location", Dictionary{{"latitude", latitude},
                                                                                            {"longitude", -1.0}}}}}}}});
        time->runPosted();
    }
    std::size_t sent() const { return transport->requests.size(); }
    std::string message() const { return controller->singleLabelView()->labelText(); }

    std::shared_ptr<FakeHost> host = std::make_shared<FakeHost>();
    std::shared_ptr<Controller> controller;
};

TEST_F(LiveSnippetTest, WithContext_RefreshingStartsWithTheDelegateAndAgainOnAppearing_IsKept) {
    makePolling();
    EXPECT_EQ(controller->refreshInterval(), 5.0);
    EXPECT_EQ(controller->timeoutInterval(), 60.0);
    time->advance(1.0);
    controller->viewWillAppear(false);
    time->advance(4.0);
    EXPECT_EQ(sent(), 1U);
    time->advance(1.0);
    EXPECT_EQ(sent(), 2U);
    EXPECT_NE(transport->requests[0].body.find(R"("handles":["ann@example.org"])"), std::string::npos);
    EXPECT_NE(transport->requests[0].body.find(R"("proximity":"dinner","serverContext":{"clientId":"c-1"})"),
              std::string::npos)
        << transport->requests[0].body;
}

TEST_F(LiveSnippetTest, WithoutContext_OneRefreshOnAppearing) {
    make(std::nullopt, {friendByEmail("Ann", "ann@example.org")});
    time->advance(100.0);
    EXPECT_EQ(sent(), 0U);
    controller->viewWillAppear(false);
    EXPECT_EQ(sent(), 0U);
    time->advance(0.0);
    EXPECT_EQ(sent(), 1U);
    answer(51.0, 5.0);
    EXPECT_TRUE(controller->refreshingCancelled());
    time->advance(100.0);
    EXPECT_EQ(sent(), 1U);
}

TEST_F(LiveSnippetTest, AnswerRedrawsAndTellsTheHost) {
    makePolling();
    controller->desiredHeightForWidth(375.0);
    time->advance(5.0);
    EXPECT_FALSE(controller->locations()[0]->hasCoordinate());
    answer(51.0, 10.0);
    ASSERT_EQ(controller->locations().size(), 1U);
    EXPECT_TRUE(controller->locations()[0]->hasCoordinate());
    EXPECT_EQ(host->heightChanges, std::vector<bool>{true});
    time->advance(10.0);
    answer(52.0, 10.0);
    EXPECT_EQ(controller->locations()[0]->velaLocation()->latitude, 52.0);
}

TEST_F(LiveSnippetTest, LocatingBecomesNoneFound_AtTheReloadAfterTheEnd) {
    makePolling();
    controller->desiredHeightForWidth(375.0);
    controller->viewWillAppear(false);
    EXPECT_EQ(message(), "Locating");
    EXPECT_TRUE(controller->isSearching());
    time->advance(5.0);
    while (!transport->waiting.empty()) {
        transport->fail(platform::HttpFailure::Network);
    }
    time->advance(54.0);
    EXPECT_EQ(message(), "Locating");
    EXPECT_TRUE(controller->isSearching());
    time->advance(1.0);
    EXPECT_FALSE(controller->isSearching()) << "ends with the refreshing, not with the next reload";
    // The end of the time and the second reload fall together; the next reload shows it at the latest.
    time->advance(30.0);
    EXPECT_TRUE(controller->refreshingCancelled());
    EXPECT_EQ(message(), "None found");
}

TEST_F(LiveSnippetTest, Disappearing_EndsRefreshing) {
    makePolling();
    controller->viewWillAppear(false);
    const auto reload = controller->reloadTimer();
    controller->viewWillDisappear(false);
    EXPECT_TRUE(controller->refreshingCancelled());
    EXPECT_EQ(controller->reloadTimer(), nullptr);
    EXPECT_FALSE(reload->isValid());
    EXPECT_FALSE(locationManagers->made.back()->updating);
}

TEST_F(LiveSnippetTest, AppearingAgain_RestartsBothTimersForOneMoreAnswer_IsKept) {
    makePolling();
    controller->viewWillAppear(false);
    controller->viewWillDisappear(false);
    time->advance(10.0);
    const auto before = sent();
    controller->viewWillAppear(false);
    EXPECT_NE(controller->reloadTimer(), nullptr);
    time->advance(5.0);
    EXPECT_EQ(sent(), before + 1);
    while (!transport->waiting.empty()) {
        answer(51.0, 5.0);
    }
    time->advance(30.0);
    EXPECT_EQ(sent(), before + 1);
}

TEST_F(LiveSnippetTest, DelegateAgain_OldControllerIsHeardWhenItGoes) {
    makePolling();
    EXPECT_FALSE(controller->refreshingCancelled());
    controller->setDelegate(host);
    EXPECT_TRUE(controller->refreshingCancelled());
    EXPECT_FALSE(controller->refreshController()->refresherCancelled());
    time->advance(5.0);
    EXPECT_EQ(sent(), 1U);
}

TEST_F(LiveSnippetTest, DelegateNone_RefreshingGoesOn) {
    makePolling();
    controller->setDelegate(nullptr);
    time->advance(5.0);
    EXPECT_EQ(sent(), 1U);
}

TEST_F(LiveSnippetTest, Teardown_EndsEverything) {
    makePolling();
    controller->viewWillAppear(false);
    const std::weak_ptr<RefreshController> refresher = controller->refreshController();
    controller.reset();
    EXPECT_TRUE(refresher.expired());
    time->advance(1000.0);
    EXPECT_EQ(sent(), 0U);
    EXPECT_EQ(time->pendingTimers(), 0U);
}

TEST_F(LiveSnippetTest, Teardown_WithARequestUnderWay) {
    makePolling();
    time->advance(5.0);
    controller.reset();
    answer(51.0, 5.0);
    time->advance(1000.0);
    EXPECT_EQ(sent(), 1U);
    EXPECT_EQ(time->pendingTimers(), 0U);
}

TEST_F(LiveSnippetTest, ResultThatIsNoFriend_BecomesARecordWithoutAnObject) {
    makePolling();
    controller->locationsUpdated(std::make_shared<const ServiceResult>(
        ServiceResult{ResultItem(Dictionary{{"a", 1}}), ResultItem(friendByEmail("Ann", "ann@example.org"))}));
    ASSERT_EQ(controller->locations().size(), 2U);
    EXPECT_EQ(controller->locations()[0]->velaLocation(), nullptr);
    EXPECT_NE(controller->locations()[1]->velaLocation(), nullptr);
    EXPECT_EQ(controller->friends().size(), 1U);
}

/// Resident memory, bytes.
std::size_t residentBytes() {
    std::ifstream statm("/proc/self/statm");
    std::size_t total = 0;
    std::size_t resident = 0;
    statm >> total >> resident;
    return resident * 4096;
}

/// Files, sockets and the like that the process has open.
std::ptrdiff_t openDescriptors() {
    return std::distance(std::filesystem::directory_iterator("/proc/self/fd"), std::filesystem::directory_iterator());
}

TEST_F(LiveSnippetTest, Month_OfPollingEveryTenSecondsGrowsNothing) {
    if (std::getenv("KTR_LONG_TESTS") == nullptr) {
        GTEST_SKIP() << "a month takes a minute: KTR_LONG_TESTS=1 runs it";
    }
    constexpr double kDay = 86400.0;
    constexpr double kInterval = 10.0;
    constexpr int kDays = 30;
    make(
        "clientId=c-1&minCallbackIntervalInMS=10000&"
        "callbackTimeoutIntervalInMS=1000000000&",
        {friendByEmail("Ann", "ann@example.org")});
    // Longer than the month; the context cannot say so in 32 bits of milliseconds.
    controller->setTimeoutInterval(2 * kDays * kDay);
    controller->refreshController()->cancelTimer();
    controller->setContextDict(std::nullopt);
    controller->setDelegate(host);
    controller->desiredHeightForWidth(375.0);
    controller->viewWillAppear(false);

    std::size_t answered = 0;
    std::size_t memory = 0;
    std::ptrdiff_t descriptors = 0;
    std::size_t timers = 0;
    std::size_t observers = 0;
    for (int day = 0; day < kDays; ++day) {
        for (double passed = 0.0; passed < kDay; passed += kInterval) {
            time->advance(kInterval);
            ASSERT_EQ(transport->waiting.size(), 1U);
            answer(51.0 + 1e-6 * static_cast<double>(answered % 1000), kInterval);
            ++answered;
        }
        transport->requests.clear();
        host->heightChanges.clear();
        log->clear();
        images->lookups = 0;
        localization->asked.clear();
        if (day == 1) {
            memory = residentBytes();
            descriptors = openDescriptors();
            timers = time->pendingTimers();
            observers = platform->notificationCenter->observerCount();
        }
    }
    EXPECT_EQ(answered, 259200U);
    EXPECT_LE(time->pendingTimers(), timers + 1);
    EXPECT_EQ(platform->notificationCenter->observerCount(), observers);
    EXPECT_EQ(openDescriptors(), descriptors);
    EXPECT_LE(residentBytes(), memory + std::size_t{8} * 1024 * 1024);
}

}  // namespace
}  // namespace ktr::test
