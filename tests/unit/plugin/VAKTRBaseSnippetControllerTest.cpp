#include "plugin/VAKTRBaseSnippetController.h"

#include "platform/layout/LayoutConstraint.h"
#include "platform/map/MapLocationManager.h"
#include "platform/ui/Label.h"
#include "platform/ui/Window.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/Results.h"

namespace ktr {

using namespace platform;
using test::FakeHost;
using test::friendByEmail;
using test::listOf;
using test::placedFriend;
using test::proximitySnippet;

namespace {

struct CountingController : VAKTRBaseSnippetController {
    int reloads = 0;
    void reloadData() override {
        VAKTRBaseSnippetController::reloadData();
        ++reloads;
    }
};

std::shared_ptr<CountingController> makeController(const std::shared_ptr<VASnippet>& snippet) {
    return create<CountingController>(&CountingController::initWithCueObject, snippet);
}

/// Content of a known height.
std::shared_ptr<Label> makeLabel(const std::string& text) {
    auto label = create<Label>(&Label::initWithFrame, Rect{});
    label->setFont({FontFace::Text, FontWeight::Regular, 10.0});
    label->setText(text);
    label->setTranslatesAutoresizingMaskIntoConstraints(false);
    return label;
}

}  // namespace

class VAKTRBaseSnippetControllerTest : public test::PlatformTest {
  protected:
    std::shared_ptr<FakeHost> host_ = std::make_shared<FakeHost>();
};

// Creation

TEST_F(VAKTRBaseSnippetControllerTest, Creation_ReadsTheSnippet) {
    const auto controller =
        makeController(proximitySnippet({placedFriend("Ann", "ann@example.org")}, "clientId=abc&incomplete=1&"));
    ASSERT_NE(controller, nullptr);
    ASSERT_EQ(controller->locations().size(), 1u);
    EXPECT_EQ(controller->locations()[0]->friendName(), "Ann");
    EXPECT_EQ(controller->proximity(), "dinner");
    EXPECT_EQ(controller->clientId(), "abc");
    ASSERT_TRUE(controller->contextDict().has_value());
    EXPECT_EQ(controller->contextDict()->size(), 2u);
    EXPECT_EQ(controller->defaultViewInsets(), EdgeInsets{});
    EXPECT_FALSE(controller->refreshingCancelled());
    EXPECT_EQ(controller->refreshController(), nullptr);
    EXPECT_EQ(controller->containerView(), nullptr);
    EXPECT_EQ(controller->currentWidth(), 0.0);
}

TEST_F(VAKTRBaseSnippetControllerTest, Creation_SnippetOfAnotherKind_HasContextAlone) {
    auto snippet = std::make_shared<VAKtrGeoFenceSnippet>();
    snippet->searchContext = Url("ktrServerContext://serverContext?clientId=abc&");
    const auto controller = makeController(snippet);
    EXPECT_TRUE(controller->locations().empty());
    EXPECT_FALSE(controller->proximity().has_value());
    EXPECT_EQ(controller->clientId(), "abc");
}

TEST_F(VAKTRBaseSnippetControllerTest, Creation_WithoutContext_LeavesItsFieldsUnset) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    EXPECT_FALSE(controller->contextDict().has_value());
    EXPECT_FALSE(controller->clientId().has_value());
    EXPECT_EQ(controller->refreshInterval(), 0.0);
    EXPECT_EQ(controller->timeoutInterval(), 0.0);
}

TEST_F(VAKTRBaseSnippetControllerTest, Creation_NoSnippet_StillDraws) {
    const auto controller = makeController(nullptr);
    ASSERT_NE(controller, nullptr);
    EXPECT_TRUE(controller->locations().empty());
}

TEST_F(VAKTRBaseSnippetControllerTest, ClientIdOfDigits_ReadsAsTheNumberItDecodedTo_IsKept) {
    EXPECT_EQ(makeController(proximitySnippet({}, "clientId=42&"))->clientId(), "42");
    EXPECT_EQ(makeController(proximitySnippet({}, "clientId=007&"))->clientId(), "7");
    EXPECT_EQ(makeController(proximitySnippet({}, "clientId=9876543210&"))->clientId(), "2147483647");
}

// The host's delegate

TEST_F(VAKTRBaseSnippetControllerTest, Delegate_GivesBundleToMapsAndLocation) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    EXPECT_EQ(controller->delegate(), host_);
    EXPECT_EQ(shared<MapLocationManager>()->effectiveBundle(), host_->bundle);
    ASSERT_EQ(locationManagers->made.size(), 1u);
    EXPECT_EQ(locationManagers->made[0]->bundle, host_->bundle);
    ASSERT_NE(controller->refreshController(), nullptr);
    EXPECT_TRUE(locationManagers->made[0]->updating);
}

TEST_F(VAKTRBaseSnippetControllerTest, Delegate_Again_ReplacesTheRefreshController) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    const auto first = controller->refreshController();
    controller->setDelegate(host_);
    EXPECT_NE(controller->refreshController(), first);
    // The replaced one is not cancelled: who still holds it still hears positions.
    EXPECT_TRUE(locationManagers->made[0]->updating);
}

TEST_F(VAKTRBaseSnippetControllerTest, Delegate_None_KeepsTheRunningRefreshController) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    const auto refresh = controller->refreshController();
    controller->setDelegate(nullptr);
    EXPECT_EQ(controller->delegate(), nullptr);
    EXPECT_EQ(controller->refreshController(), refresh);
    EXPECT_TRUE(locationManagers->made[0]->updating);
    EXPECT_EQ(locationManagers->made.size(), 1u);
}

TEST_F(VAKTRBaseSnippetControllerTest, Delegate_NoneFromTheStart_MakesNoRefreshController) {
    const auto controller = makeController(proximitySnippet({}, "minCallbackIntervalInMS=2500&"));
    controller->setDelegate(nullptr);
    EXPECT_EQ(controller->refreshController(), nullptr);
    EXPECT_EQ(controller->refreshInterval(), 0.0);
}

TEST_F(VAKTRBaseSnippetControllerTest, Delegate_IsHeldWeakly) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    host_.reset();
    EXPECT_EQ(controller->delegate(), nullptr);
    controller->viewNeedsResize();
    controller->handleURL(Url("wayloc://friends/"));
}

TEST_F(VAKTRBaseSnippetControllerTest, Intervals_AreReadInMillisecondsWhenTheDelegateArrives) {
    const auto controller =
        makeController(proximitySnippet({}, "minCallbackIntervalInMS=2500&callbackTimeoutIntervalInMS=60000&"));
    EXPECT_EQ(controller->refreshInterval(), 0.0);
    controller->setDelegate(host_);
    EXPECT_EQ(controller->refreshInterval(), 2.5);
    EXPECT_EQ(controller->timeoutInterval(), 60.0);
}

TEST_F(VAKTRBaseSnippetControllerTest, Intervals_MissingOrUnreadable_AreZero) {
    const auto controller = makeController(proximitySnippet({}, "minCallbackIntervalInMS=soon&"));
    controller->setRefreshInterval(9.0);
    controller->setTimeoutInterval(9.0);
    controller->setDelegate(host_);
    EXPECT_EQ(controller->refreshInterval(), 0.0);
    EXPECT_EQ(controller->timeoutInterval(), 0.0);
}

TEST_F(VAKTRBaseSnippetControllerTest, Intervals_ContextOfNothing_AreZero) {
    const auto controller = makeController(proximitySnippet({}, ""));
    EXPECT_TRUE(controller->contextDict().has_value());
    controller->setDelegate(host_);
    EXPECT_EQ(controller->refreshInterval(), 0.0);
}

// Locations

TEST_F(VAKTRBaseSnippetControllerTest, SameListAgain_KeepsTheRecords) {
    const auto controller = makeController(proximitySnippet({}));
    const auto list = listOf({placedFriend("Ann", "ann@example.org")});
    controller->setLocations(list);
    const auto record = controller->locations()[0];
    controller->setLocations(list);
    EXPECT_EQ(controller->locations()[0], record);
    controller->setLocations(listOf(*list));
    EXPECT_NE(controller->locations()[0], record);
}

TEST_F(VAKTRBaseSnippetControllerTest, Locations_KeepTheirOrder) {
    const auto controller =
        makeController(proximitySnippet({friendByEmail("Ann", "a@example.org"), friendByEmail("Bo", "b@example.org")}));
    ASSERT_EQ(controller->locations().size(), 2u);
    EXPECT_EQ(controller->locations()[0]->friendName(), "Ann");
    EXPECT_EQ(controller->locations()[1]->friendName(), "Bo");
}

TEST_F(VAKTRBaseSnippetControllerTest, Locations_None_IsAnEmptyList) {
    const auto controller = makeController(proximitySnippet({friendByEmail("Ann", "a@example.org")}));
    controller->setLocations(nullptr);
    EXPECT_TRUE(controller->locations().empty());
}

TEST_F(VAKTRBaseSnippetControllerTest, Friends_AreThePersonsOfTheRecords_WithoutNobody) {
    const auto ann = friendByEmail("Ann", "a@example.org");
    auto withoutPerson = friendByEmail("Bo", "b@example.org");
    withoutPerson->friend_->object = nullptr;
    const auto cy = friendByEmail("Cy", "c@example.org");
    const auto controller =
        makeController(proximitySnippet({ann, withoutPerson, std::make_shared<VAKtrLocation>(), nullptr, cy}));
    EXPECT_EQ(controller->friends(),
              (std::vector<std::shared_ptr<VAPerson>>{ann->friend_->object, cy->friend_->object}));
}

TEST_F(VAKTRBaseSnippetControllerTest, DisambiguatedLocation_IsTheFirstEvenWithoutCoordinate_IsKept) {
    const auto controller =
        makeController(proximitySnippet({friendByEmail("Ann", "a@example.org"), placedFriend("Bo", "b@example.org")}));
    EXPECT_EQ(controller->disambiguatedLocation(), controller->locations()[0]);
    EXPECT_EQ(makeController(proximitySnippet({}))->disambiguatedLocation(), nullptr);
}

TEST_F(VAKTRBaseSnippetControllerTest, DisambiguatedLocation_StoredOneIsNeverRead_IsKept) {
    const auto controller = makeController(proximitySnippet({placedFriend("Ann", "a@example.org")}));
    controller->setDisambiguatedLocation(KTRVALocation::locationWithVelaLocation(placedFriend("Bo", "b@example.org")));
    EXPECT_EQ(controller->disambiguatedLocation(), controller->locations()[0]);
}

TEST_F(VAKTRBaseSnippetControllerTest, LocationsUpdated_StoresRedrawsAndTellsTheHost) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    controller->locationsUpdated(test::resultOf(listOf({placedFriend("Ann", "a@example.org")})));
    EXPECT_EQ(controller->locations().size(), 1u);
    EXPECT_EQ(controller->reloads, 1);
    EXPECT_EQ(host_->heightChanges, std::vector<bool>{true});
}

TEST_F(VAKTRBaseSnippetControllerTest, RefreshCancelled_IsRememberedAndRedrawsNothing) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    controller->refreshCancelled();
    EXPECT_TRUE(controller->refreshingCancelled());
    EXPECT_EQ(controller->reloads, 0);
    EXPECT_TRUE(host_->heightChanges.empty());
}

TEST_F(VAKTRBaseSnippetControllerTest, ViewNeedsResize_PinsTheTop) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    controller->viewNeedsResize();
    EXPECT_EQ(host_->heightChanges, std::vector<bool>{true});
    EXPECT_EQ(controller->reloads, 0);
}

// URLs

TEST_F(VAKTRBaseSnippetControllerTest, HandleUrl_IsOpenedByTheHost) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    controller->handleURL(Url("wayloc://friends/"));
    EXPECT_EQ(host_->opened, std::vector<Url>{Url("wayloc://friends/")});
}

TEST_F(VAKTRBaseSnippetControllerTest, OpenUrl_Failure_IsAnErrorLineOnly) {
    const auto controller = makeController(proximitySnippet({}));
    controller->setDelegate(host_);
    host_->opens = false;
    expectErrorLine("Unable to open url: wayloc://friends/");
    controller->openURL(Url("wayloc://friends/"));
    EXPECT_TRUE(log->has(LogLevel::Error, "Unable to open url: wayloc://friends/"));
}

// View

TEST_F(VAKTRBaseSnippetControllerTest, LoadView_MakesAnEmptyVerticalStack) {
    const auto controller = makeController(proximitySnippet({}));
    const auto view = controller->view();
    ASSERT_NE(controller->containerView(), nullptr);
    EXPECT_EQ(view, controller->containerView());
    EXPECT_EQ(controller->containerView()->axis(), StackView::Axis::Vertical);
    EXPECT_FALSE(view->translatesAutoresizingMaskIntoConstraints());
    EXPECT_EQ(view->frame(), Rect{});
    EXPECT_TRUE(view->subviews().empty());
}

TEST_F(VAKTRBaseSnippetControllerTest, UpdateViewConstraints_PinsTheViewToItsSuperview) {
    const auto controller = makeController(proximitySnippet({}));
    const auto card = create<View>(&View::initWithFrame, Rect{0.0, 0.0, 300.0, 120.0});
    card->addSubview(controller->view());
    controller->updateViewConstraints();
    card->layoutIfNeeded();
    EXPECT_EQ(controller->view()->frame(), (Rect{0.0, 0.0, 300.0, 120.0}));
    card->setFrame({0.0, 0.0, 200.0, 80.0});
    card->layoutIfNeeded();
    EXPECT_EQ(controller->view()->frame(), (Rect{0.0, 0.0, 200.0, 80.0}));
}

TEST_F(VAKTRBaseSnippetControllerTest, UpdateViewConstraints_EachCallMakesNewOnes_IsKept) {
    const auto controller = makeController(proximitySnippet({}));
    const auto card = create<View>(&View::initWithFrame, Rect{0.0, 0.0, 300.0, 120.0});
    card->addSubview(controller->view());
    controller->updateViewConstraints();
    const auto first = card->constraints();
    ASSERT_EQ(first.size(), 4u);
    // Had the earlier ones been kept and only activated again, taking them away would leave nothing to make anew.
    for (const auto& constraint : first) {
        card->removeConstraint(constraint);
    }
    controller->updateViewConstraints();
    const auto second = card->constraints();
    ASSERT_EQ(second.size(), 4u);
    for (std::size_t i = 0; i < second.size(); ++i) {
        EXPECT_NE(second[i], first[i]);
    }
    // Equal ones beside those already held cost nothing and change nothing.
    controller->updateViewConstraints();
    card->layoutIfNeeded();
    EXPECT_EQ(controller->view()->frame(), (Rect{0.0, 0.0, 300.0, 120.0}));
}

TEST_F(VAKTRBaseSnippetControllerTest, UpdateViewConstraints_WithoutSuperview_MakesNothing) {
    const auto controller = makeController(proximitySnippet({}));
    controller->view();
    controller->updateViewConstraints();
    EXPECT_TRUE(controller->view()->constraints().empty());
    EXPECT_TRUE(log->texts(LogLevel::Debug).empty());
}

TEST_F(VAKTRBaseSnippetControllerTest, DesiredHeight_IsTheContainersSmallest) {
    const auto controller = makeController(proximitySnippet({}));
    controller->view();
    controller->containerView()->addArrangedSubview(makeLabel("one"));
    controller->containerView()->addArrangedSubview(makeLabel("two"));
    EXPECT_EQ(controller->desiredHeightForWidth(300.0), 28.0);
    EXPECT_EQ(controller->currentWidth(), 300.0);
}

TEST_F(VAKTRBaseSnippetControllerTest, DesiredHeight_WithoutContainer_IsZeroAndLoadsNothing) {
    const auto controller = makeController(proximitySnippet({}));
    EXPECT_EQ(controller->desiredHeightForWidth(300.0), 0.0);
    EXPECT_EQ(controller->viewIfLoaded(), nullptr);
}

TEST_F(VAKTRBaseSnippetControllerTest, DesiredHeight_InWindow_LaysTheContainerOut) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 300.0, 500.0});
    const auto controller = makeController(proximitySnippet({}));
    controller->view()->setFrame({0.0, 0.0, 300.0, 100.0});
    const auto label = makeLabel("one");
    controller->containerView()->addArrangedSubview(label);
    controller->desiredHeightForWidth(300.0);
    EXPECT_EQ(label->frame(), Rect{});
    window->addSubview(controller->view());
    controller->desiredHeightForWidth(300.0);
    EXPECT_EQ(label->frame(), (Rect{0.0, 0.0, 300.0, 100.0}));
}

TEST_F(VAKTRBaseSnippetControllerTest, Sash_HasTitleAndIconOfThePluginsBundle) {
    localization->set("org.ktr.snippets", "APPLICATION_NAME", "Friends");
    const auto icon = std::make_shared<test::FakeImage>();
    images->named["org.ktr.snippets/appIcon_dyn"] = icon;
    const auto sash = makeController(proximitySnippet({}))->sashItem();
    ASSERT_NE(sash, nullptr);
    EXPECT_EQ(sash->title(), "Friends");
    EXPECT_EQ(sash->image(), icon);
}

// The reload timer

TEST_F(VAKTRBaseSnippetControllerTest, OnScreen_ReloadsEveryThirtySeconds) {
    const auto controller = makeController(proximitySnippet({}));
    controller->viewWillAppear(false);
    ASSERT_NE(controller->reloadTimer(), nullptr);
    EXPECT_EQ(controller->reloadTimer()->interval(), 30.0);
    time->advance(29.9);
    EXPECT_EQ(controller->reloads, 0);
    time->advance(0.2);
    EXPECT_EQ(controller->reloads, 1);
    time->advance(60.0);
    EXPECT_EQ(controller->reloads, 3);
}

TEST_F(VAKTRBaseSnippetControllerTest, HiddenAndShownAgain_RestartsTheTimer) {
    const auto controller = makeController(proximitySnippet({}));
    controller->viewWillAppear(false);
    time->advance(20.0);
    controller->viewWillDisappear(false);
    EXPECT_EQ(controller->reloadTimer(), nullptr);
    time->advance(100.0);
    EXPECT_EQ(controller->reloads, 0);
    EXPECT_EQ(time->pendingTimers(), 0u);
    controller->viewWillAppear(false);
    time->advance(29.0);
    EXPECT_EQ(controller->reloads, 0);
    time->advance(1.0);
    EXPECT_EQ(controller->reloads, 1);
    controller->viewWillDisappear(false);
    controller->viewWillDisappear(false);
    EXPECT_EQ(controller->reloadTimer(), nullptr);
}

TEST_F(VAKTRBaseSnippetControllerTest, ShownTwice_EarlierTimerGoesOn_IsKept) {
    const auto controller = makeController(proximitySnippet({}));
    controller->viewWillAppear(false);
    controller->viewWillAppear(false);
    time->advance(30.0);
    EXPECT_EQ(controller->reloads, 2);
    controller->viewWillDisappear(false);
    time->advance(30.0);
    EXPECT_EQ(controller->reloads, 3);
}

// Ownership

TEST_F(VAKTRBaseSnippetControllerTest, DroppedOnScreen_LeaksNothingAndItsTimerEnds) {
    auto controller = makeController(proximitySnippet({placedFriend("Ann", "a@example.org")}));
    controller->setDelegate(host_);
    controller->view();
    controller->viewWillAppear(false);
    const std::weak_ptr<VAKTRBaseSnippetController> gone = controller;
    const std::weak_ptr<RefreshController> refresh = controller->refreshController();
    const std::weak_ptr<View> view = controller->view();
    const std::weak_ptr<KTRVALocation> record = controller->locations()[0];
    controller.reset();
    EXPECT_TRUE(gone.expired());
    EXPECT_TRUE(refresh.expired());
    EXPECT_TRUE(view.expired());
    EXPECT_TRUE(record.expired());
    EXPECT_FALSE(locationManagers->made[0]->updating);
    EXPECT_EQ(time->pendingTimers(), 1u);
    time->advance(30.0);
    EXPECT_EQ(time->pendingTimers(), 0u);
}

}  // namespace ktr
