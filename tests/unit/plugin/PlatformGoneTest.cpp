// What is still to come when a host takes its platform away before it lets its controllers go: answers, ticks, the end
// of the asking, and positions find nobody, and nothing happens.
#include "plugin/VAKTRLocationSnippetController.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "plugin/VAKTRVisibilityController.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

using platform::Dictionary;

constexpr const char* kContext = "minCallbackIntervalInMS=5000&callbackTimeoutIntervalInMS=60000&";

class PlatformGoneTest : public PlatformTest {
  protected:
    PlatformGoneTest() { locationManagers->cached = position(51.5, -2.5); }
    void show(const std::shared_ptr<VAKTRBaseSnippetController>& made) {
        controller = made;
        controller->setDelegate(host);
        controller->desiredHeightForWidth(375.0);
        controller->viewWillAppear(false);
        time->advance(5.0);
        ASSERT_FALSE(transport->waiting.empty());
    }
    void showSharing() {
        const auto snippet = std::make_shared<platform::VAKtrVisibilityView>();
        snippet->visible = true;
        snippet->searchContext = platform::Url(std::string("ktrServerContext://serverContext?") + kContext);
        show(platform::create<VAKTRVisibilityController>(&VAKTRVisibilityController::initWithCueObject, snippet));
    }
    void showFriends() {
        show(platform::create<VAKTRMultipleLocationsSnippetController>(
            &VAKTRMultipleLocationsSnippetController::initWithCueObject,
            proximitySnippet({friendByEmail("Ann", "ann@example.org")}, kContext)));
    }
    void answer() {
        const Dictionary place{{"latitude", 51.5}, {"longitude", -2.5}};
        transport->answer({{"serverContext", Dictionary{{"minCallbackIntervalInMS", 5000}}},
                           {"myInfo", Dictionary{{"preferredEmail", "mara@example.org"}, {"location", place}}},
                           {"locations", Dictionary{{"ann@example.org", Dictionary{{"location", place}}}}}});
    }
    void takeThePlatformAway() { platform::Platform::install(nullptr); }

    std::shared_ptr<FakeHost> host = std::make_shared<FakeHost>();
    std::shared_ptr<VAKTRBaseSnippetController> controller;
};

TEST_F(PlatformGoneTest, AnswerAboutFriends_IsNotHandled) {
    showFriends();
    const auto before = controller->locations();
    answer();
    takeThePlatformAway();
    time->runPosted();
    EXPECT_EQ(controller->locations(), before);
}

TEST_F(PlatformGoneTest, AnswerAboutSharing_IsNotHandled) {
    showSharing();
    const auto before = std::static_pointer_cast<VAKTRVisibilityController>(controller)->myLocation();
    answer();
    takeThePlatformAway();
    time->runPosted();
    EXPECT_EQ(std::static_pointer_cast<VAKTRVisibilityController>(controller)->myLocation(), before);
}

TEST_F(PlatformGoneTest, AnswerThatComesAfterwards_IsNotHandled) {
    showSharing();
    takeThePlatformAway();
    answer();
    time->runPosted();
    EXPECT_TRUE(host->heightChanges.empty());
}

TEST_F(PlatformGoneTest, TimersAndTheEndOfTheAsking_DoNothing) {
    for (const bool sharing : {true, false}) {
        platform::Platform::install(platform);
        sharing ? showSharing() : showFriends();
        answer();
        time->runPosted();
        const auto sent = transport->requests.size();
        const auto told = host->heightChanges.size();
        takeThePlatformAway();
        time->advance(1000.0);
        EXPECT_EQ(transport->requests.size(), sent);
        EXPECT_EQ(host->heightChanges.size(), told);
        EXPECT_FALSE(controller->refreshingCancelled());
        controller.reset();
        time->advance(1.0);
    }
}

}  // namespace
}  // namespace ktr::test
