#include "plugin/VAKTRMultipleLocationsSnippetController.h"

#include "platform/ui/Window.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/Results.h"

namespace ktr {

using namespace platform;
using test::contactWith;
using test::FakeHost;
using test::friendByEmail;
using test::listOf;
using test::placed;
using test::placedFriend;
using test::proximitySnippet;

using Controller = VAKTRMultipleLocationsSnippetController;
using Views = std::vector<std::shared_ptr<View>>;

/// At L a friend row is 78.5 high, a label row of one line 48, of none 30.
class VAKTRMultipleLocationsSnippetControllerTest : public test::PlatformTest {
  protected:
    VAKTRMultipleLocationsSnippetControllerTest() {
        localization->set("org.ktr.snippets", "LOCATING_FRIENDS", "Locating");
        localization->set("org.ktr.snippets", "NO_FRIENDS_FOUND", "Nobody");
        localization->set("org.ktr.snippets", "SHOW_ALL", "Show all");
    }

    std::shared_ptr<Controller> makeController(LocationList locations,
                                               std::optional<std::string> context = std::nullopt) {
        auto controller =
            create<Controller>(&Controller::initWithCueObject, proximitySnippet(std::move(locations), context));
        controller->setDelegate(host_);
        return controller;
    }
    static Views shown(const std::shared_ptr<Controller>& controller) {
        return controller->containerView()->arrangedSubviews();
    }
    static std::shared_ptr<KTRVelaFriendView> rowAt(const std::shared_ptr<Controller>& controller, std::size_t index) {
        return std::dynamic_pointer_cast<KTRVelaFriendView>(shown(controller).at(index));
    }
    /// The names that are shown, "label: text" for the label row.
    static std::vector<std::string> texts(const std::shared_ptr<Controller>& controller) {
        std::vector<std::string> all;
        for (const auto& view : shown(controller)) {
            if (view == controller->singleLabelView()) {
                all.push_back("label: " + controller->singleLabelView()->labelText());
            } else {
                all.push_back(std::dynamic_pointer_cast<KTRVelaFriendView>(view)->nameLabel()->text());
            }
        }
        return all;
    }
    static void update(const std::shared_ptr<Controller>& controller, LocationList locations) {
        controller->locationsUpdated(test::resultOf(listOf(std::move(locations))));
    }
    static std::shared_ptr<VAKtrLocation> ann() { return placedFriend("Ann", "ann@example.org"); }
    static std::shared_ptr<VAKtrLocation> bo() { return placedFriend("Bo", "bo@example.org"); }
    static std::shared_ptr<VAKtrLocation> cy() { return placedFriend("Cy", "cy@example.org"); }
    static std::shared_ptr<VAKtrLocation> lostAnn() { return friendByEmail("Ann", "ann@example.org"); }
    static std::shared_ptr<VAKtrLocation> lostCy() { return friendByEmail("Cy", "cy@example.org"); }
    static std::shared_ptr<VAKtrLocation> nobody() { return placed(std::make_shared<VAKtrLocation>(), 51.0, -1.0); }

    std::shared_ptr<FakeHost> host_ = std::make_shared<FakeHost>();
};

using Strings = std::vector<std::string>;

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, OneKnownOfThree_IsOneRowWithoutSeparator) {
    const auto controller = makeController({lostAnn(), bo(), lostCy()});
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(texts(controller), Strings{"Bo"});
    EXPECT_FALSE(rowAt(controller, 0)->separatorEnabled());
    EXPECT_TRUE(rowAt(controller, 0)->separatorView()->hidden());
    EXPECT_EQ(controller->singleLabelView()->superview(), nullptr);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, OneKnownOfThree_Incomplete_HasSeparatorAndShowAllRow) {
    const auto controller = makeController({lostAnn(), bo(), lostCy()}, "incomplete=1&");
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(texts(controller), (Strings{"Bo", "label: Show all"}));
    EXPECT_TRUE(rowAt(controller, 0)->separatorEnabled());
    EXPECT_TRUE(controller->singleLabelView()->isShowAll());
    EXPECT_EQ(controller->singleLabelView()->label()->textAlignment(), TextAlignment::Center);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Incomplete_IsReadAsABoolean) {
    for (const auto& [value, expected] : std::vector<std::pair<std::string, bool>>{
             {"1", true}, {"0", false}, {"-7", true}, {"true", true}, {"YES", true}, {"no", false}, {"", false}}) {
        EXPECT_EQ(makeController({}, "incomplete=" + value + "&")->displayShowAllRow(), expected) << value;
    }
    EXPECT_FALSE(makeController({}, "clientId=1&")->displayShowAllRow());
    EXPECT_FALSE(makeController({})->displayShowAllRow());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Rows_StandInTheAssistantsOrder_OnlyTheLastWithoutSeparator) {
    const auto controller = makeController({cy(), ann(), bo()});
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(texts(controller), (Strings{"Cy", "Ann", "Bo"}));
    EXPECT_TRUE(rowAt(controller, 0)->separatorEnabled());
    EXPECT_TRUE(rowAt(controller, 1)->separatorEnabled());
    EXPECT_FALSE(rowAt(controller, 2)->separatorEnabled());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Rows_AreTiedToControllerAndRefreshController) {
    const auto controller = makeController({ann()});
    controller->desiredHeightForWidth(250.0);
    const auto row = rowAt(controller, 0);
    EXPECT_EQ(row->urlHandler(), controller);
    EXPECT_EQ(row->viewDelegate(), controller);
    EXPECT_EQ(row->currentLocationDelegate(), controller->refreshController());
    EXPECT_FALSE(row->translatesAutoresizingMaskIntoConstraints());
    EXPECT_EQ(row->frame(), (Rect{0.0, 0.0, 250.0, 0.0}));
    EXPECT_EQ(controller->singleLabelView()->urlHandler(), controller);
    EXPECT_EQ(controller->singleLabelView()->frame(), (Rect{0.0, 0.0, 250.0, 0.0}));
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, EveryKnownFriend_GetsARow) {
    LocationList many;
    for (int i = 0; i < 500; ++i) {
        many.push_back(placedFriend("Friend", std::to_string(i) + "@example.org"));
    }
    const auto controller = makeController(many);
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(shown(controller).size(), 500u);
    EXPECT_EQ(controller->friendViews().size(), 500u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Tap_OpensTheFriendThroughTheHost) {
    const auto controller = makeController({ann()}, "incomplete=1&");
    controller->desiredHeightForWidth(320.0);
    rowAt(controller, 0)->viewTouched();
    controller->singleLabelView()->viewTouched();
    EXPECT_EQ(host_->opened, (std::vector<Url>{Url("wayloc://friend/ann@example.org"), Url("wayloc://friends/")}));
}

// Locating

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, NobodyKnown_SaysLocating_ThenNobodyFoundAtTheNextReload) {
    const auto controller = makeController({lostAnn(), lostCy()});
    controller->desiredHeightForWidth(320.0);
    EXPECT_TRUE(controller->showLocatingFriends());
    EXPECT_EQ(texts(controller), Strings{"label: Locating"});
    EXPECT_FALSE(controller->singleLabelView()->isShowAll());
    controller->viewWillAppear(false);
    controller->refreshCancelled();
    EXPECT_EQ(texts(controller), Strings{"label: Locating"});
    time->advance(30.0);
    EXPECT_EQ(texts(controller), Strings{"label: Nobody"});
    EXPECT_EQ(controller->singleLabelView()->label()->text(), "Nobody");
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, EmptyList_IsLocating) {
    const auto controller = makeController({});
    controller->desiredHeightForWidth(320.0);
    EXPECT_TRUE(controller->showLocatingFriends());
    EXPECT_EQ(texts(controller), Strings{"label: Locating"});
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, CoordinateZero_IsKnown) {
    const auto controller = makeController({placed(lostAnn(), 0.0, 0.0)});
    EXPECT_FALSE(controller->showLocatingFriends());
    EXPECT_EQ(controller->proximityLocationsWithCoordinates().size(), 1u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, LocatingAgain_RowsLeaveTheArrangementOnly_IsKept) {
    const auto controller = makeController({ann(), bo()});
    controller->desiredHeightForWidth(320.0);
    const auto row = rowAt(controller, 0);
    update(controller, {lostAnn()});
    EXPECT_EQ(texts(controller), Strings{"label: Locating"});
    EXPECT_EQ(row->superview(), controller->containerView());
    EXPECT_EQ(controller->friendViews().size(), 2u);
    // Neither laid out, painted, hit nor spoken.
    EXPECT_EQ(controller->containerView()->presentedSubviews(), Views{controller->singleLabelView()});
    update(controller, {ann(), bo()});
    EXPECT_EQ(texts(controller), (Strings{"Ann", "Bo"}));
    EXPECT_EQ(rowAt(controller, 0), row);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, ShowAllRightAfterLocating_KeepsNaturalAlignmentUntilReload_IsKept) {
    const auto controller = makeController({lostAnn()}, "incomplete=1&");
    controller->desiredHeightForWidth(320.0);
    update(controller, {ann()});
    EXPECT_EQ(texts(controller), (Strings{"Ann", "label: Show all"}));
    EXPECT_TRUE(controller->singleLabelView()->isShowAll());
    EXPECT_EQ(controller->singleLabelView()->label()->textAlignment(), TextAlignment::Natural);
    controller->reloadData();
    EXPECT_EQ(controller->singleLabelView()->label()->textAlignment(), TextAlignment::Center);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, LocatingRightAfterShowAll_StandsAtTheLeadingEdge) {
    const auto controller = makeController({ann()}, "incomplete=1&");
    controller->desiredHeightForWidth(320.0);
    update(controller, {lostAnn()});
    EXPECT_FALSE(controller->singleLabelView()->isShowAll());
    EXPECT_EQ(controller->singleLabelView()->label()->textAlignment(), TextAlignment::Natural);
    controller->singleLabelView()->viewTouched();
    EXPECT_TRUE(host_->opened.empty());
}

// Finding rows again

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, SameFriendsInAnotherOrder_KeepTheirRows) {
    const auto controller = makeController({ann(), bo(), cy()});
    controller->desiredHeightForWidth(320.0);
    const Views before = shown(controller);
    update(controller, {cy(), ann(), bo()});
    EXPECT_EQ(shown(controller), (Views{before[2], before[0], before[1]}));
    EXPECT_EQ(texts(controller), (Strings{"Cy", "Ann", "Bo"}));
    EXPECT_TRUE(rowAt(controller, 0)->separatorEnabled());
    EXPECT_FALSE(rowAt(controller, 2)->separatorEnabled());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, FewerFriends_SurplusRowsLeaveTheTree) {
    const auto controller = makeController({ann(), bo(), cy()});
    controller->desiredHeightForWidth(320.0);
    const Views before = shown(controller);
    update(controller, {cy()});
    EXPECT_EQ(shown(controller), Views{before[2]});
    EXPECT_EQ(before[0]->superview(), nullptr);
    EXPECT_EQ(before[1]->superview(), nullptr);
    EXPECT_EQ(controller->friendViews().size(), 1u);
    EXPECT_EQ(controller->containerView()->subviews(), Views{before[2]});
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, OtherFriends_ReplacedRowsLeaveTheTree) {
    const auto controller = makeController({ann(), bo()});
    controller->desiredHeightForWidth(320.0);
    const std::weak_ptr<View> old = shown(controller)[0];
    update(controller, {cy(), bo()});
    EXPECT_EQ(texts(controller), (Strings{"Cy", "Bo"}));
    time->advance(0.1);
    EXPECT_TRUE(old.expired());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, OtherFriendsAfterLocating_WaitingRowsLeaveTheTree) {
    const auto controller = makeController({ann(), bo()});
    controller->desiredHeightForWidth(320.0);
    const auto waiting = rowAt(controller, 0);
    update(controller, {lostAnn()});
    update(controller, {cy()});
    EXPECT_EQ(waiting->superview(), nullptr);
    EXPECT_EQ(controller->containerView()->subviews(), shown(controller));
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, ShowAllNoLongerWanted_LabelLeavesTheTree) {
    const auto controller = makeController({ann()}, "incomplete=1&");
    controller->desiredHeightForWidth(320.0);
    controller->setDisplayShowAllRow(false);
    controller->reloadData();
    EXPECT_EQ(texts(controller), Strings{"Ann"});
    EXPECT_EQ(controller->singleLabelView()->superview(), nullptr);
    controller->setDisplayShowAllRow(true);
    controller->reloadData();
    EXPECT_EQ(texts(controller), (Strings{"Ann", "label: Show all"}));
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, SameHandleTwice_IsOneRowAtTheLaterIndex) {
    const auto controller = makeController({ann(), bo(), ann()}, "incomplete=1&");
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(controller->friendViews().size(), 2u);
    EXPECT_EQ(texts(controller).at(0), "Bo");
    const auto all = texts(controller);
    EXPECT_EQ(std::count(all.begin(), all.end(), "Ann"), 1);
    EXPECT_EQ(all.back(), "label: Show all");
    controller->reloadData();
    EXPECT_EQ(texts(controller), all);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, SameHandleTwice_TheLabelLeavesAndTheHeightHoldsTheRows) {
    const auto controller = makeController({ann(), bo(), ann()});
    const double height = controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(height, 2 * 78.5);
    EXPECT_EQ(texts(controller), (Strings{"Bo", "Ann"}));
    EXPECT_EQ(controller->singleLabelView()->superview(), nullptr);
    EXPECT_TRUE(rowAt(controller, 0)->separatorEnabled());
    EXPECT_FALSE(rowAt(controller, 1)->separatorEnabled());
    controller->view()->setFrame({0.0, 0.0, 320.0, height});
    controller->view()->layoutIfNeeded();
    EXPECT_EQ(rowAt(controller, 1)->frame().maxY(), height) << "the last friend is cut off";
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, SameHandleTwice_ShowsItsLastRecord) {
    const auto controller = makeController({ann(), placedFriend("Ann M.", "ann@example.org")});
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(texts(controller), Strings{"Ann M."});
    EXPECT_FALSE(rowAt(controller, 0)->separatorEnabled());
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, SameHandleAThousandTimes_IsFilledOnceAndHasOneAvatarStep) {
    const auto controller = makeController({ann()});
    controller->desiredHeightForWidth(320.0);
    time->runUntilIdle(1.0);
    const std::size_t timers = time->pendingTimers();
    const int lookups = contacts->fetches;
    contacts->contacts = {contactWith("ann", "ann@example.org", "")};
    update(controller, LocationList(1000, ann()));
    EXPECT_EQ(time->pendingTimers(), timers + 1);
    EXPECT_EQ(contacts->fetches, lookups + 1);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, SameFriendsAgain_ShowWhatIsNewInTheSameRows) {
    const auto controller = makeController({ann(), bo()});
    controller->desiredHeightForWidth(320.0);
    const Views before = shown(controller);
    auto moved = bo();
    moved->city = "Elsewhere";
    update(controller, {ann(), moved});
    EXPECT_EQ(shown(controller), before);
    EXPECT_EQ(std::static_pointer_cast<KTRVelaFriendView>(before[1])->locationLabel()->text(), "Elsewhere");
    EXPECT_TRUE(std::static_pointer_cast<KTRVelaFriendView>(before[0])->separatorEnabled());
    EXPECT_FALSE(std::static_pointer_cast<KTRVelaFriendView>(before[1])->separatorEnabled());
    // In another order, or with one row somewhere else, it is arranged again.
    update(controller, {bo(), ann()});
    EXPECT_EQ(shown(controller), (Views{before[1], before[0]}));
    controller->containerView()->setArrangedSubviews({before[0]});
    update(controller, {bo(), ann()});
    EXPECT_EQ(shown(controller), (Views{before[1], before[0]}));
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, OtherRowsBySetter_AreTheOnesThatAreFilled) {
    const auto controller = makeController({ann()});
    controller->desiredHeightForWidth(320.0);
    const Views before = shown(controller);
    controller->setFriendViews({});
    update(controller, {ann()});
    ASSERT_EQ(shown(controller).size(), 1u);
    EXPECT_NE(shown(controller)[0], before[0]);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, SameHandleTwice_RowsOfOthersLeaveTheTree) {
    const auto controller = makeController({bo(), cy()});
    controller->desiredHeightForWidth(320.0);
    const Views before = shown(controller);
    update(controller, {ann(), ann()});
    EXPECT_EQ(texts(controller), Strings{"Ann"});
    EXPECT_EQ(before[0]->superview(), nullptr);
    EXPECT_EQ(before[1]->superview(), nullptr);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, WithoutHandle_EachRecordHasARowOfItsOwn) {
    const auto controller = makeController({nobody(), ann(), nobody()});
    EXPECT_EQ(controller->desiredHeightForWidth(320.0), 3 * 78.5);
    EXPECT_EQ(controller->friendViews().size(), 3u);
    EXPECT_EQ(texts(controller), (Strings{"", "Ann", ""}));
    EXPECT_NE(shown(controller)[0], shown(controller)[2]);
    const Views before = shown(controller);
    controller->reloadData();
    EXPECT_EQ(shown(controller), before);
    update(controller, {ann()});
    EXPECT_EQ(controller->containerView()->subviews(), Views{before[1]});
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, EmptyHandle_IsAHandle) {
    auto first = placed(friendByEmail("Ann", ""), 51.0, -1.0);
    auto second = placed(friendByEmail("Ann", ""), 51.0, -1.0);
    const auto controller = makeController({first, second, nobody()});
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(controller->friendViews().size(), 2u);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, UnchangedReload_ShapesAndArrangesNothing) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
    const auto controller = makeController({ann(), bo()}, "incomplete=1&");
    controller->view()->setFrame({0.0, 0.0, 320.0, controller->desiredHeightForWidth(320.0)});
    window->addSubview(controller->view());
    controller->desiredHeightForWidth(320.0);
    const int shaped = textEngine->count();
    controller->reloadData();
    window->layoutIfNeeded();
    EXPECT_EQ(textEngine->count(), shaped);
}

// Heights

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Height_IsTheSumOfTheRows) {
    EXPECT_EQ(makeController({ann(), bo(), lostCy()})->desiredHeightForWidth(320.0), 157.0);
    EXPECT_EQ(makeController({ann(), bo()}, "incomplete=1&")->desiredHeightForWidth(320.0), 205.0);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Height_NoLocations_IsTheLabels) {
    EXPECT_EQ(makeController({})->desiredHeightForWidth(320.0), 48.0);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Height_Locating_IsNinety_IsKept) {
    const auto controller = makeController({lostAnn(), lostCy()});
    EXPECT_EQ(controller->desiredHeightForWidth(320.0), 90.0);
    EXPECT_EQ(controller->currentWidth(), 320.0);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Height_LocatingIncomplete_IsTheLabels_IsKept) {
    EXPECT_EQ(makeController({lostAnn()}, "incomplete=1&")->desiredHeightForWidth(320.0), 48.0);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Height_LocatingAgain_SumsTheKeptRows_IsKept) {
    const auto controller = makeController({ann(), bo()});
    controller->desiredHeightForWidth(320.0);
    update(controller, {lostAnn()});
    EXPECT_EQ(controller->desiredHeightForWidth(320.0), 157.0);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Height_LoadsTheViewOnce) {
    const auto controller = makeController({ann()});
    controller->desiredHeightForWidth(320.0);
    const auto container = controller->containerView();
    controller->desiredHeightForWidth(200.0);
    EXPECT_EQ(controller->containerView(), container);
    EXPECT_EQ(controller->view(), container);
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, LaidOut_RowsStandOneUnderTheOther) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
    const auto card = create<View>(&View::initWithFrame, Rect{0.0, 0.0, 320.0, 0.0});
    const auto controller = makeController({ann(), bo()}, "incomplete=1&");
    card->setFrame({0.0, 0.0, 320.0, controller->desiredHeightForWidth(320.0)});
    window->addSubview(card);
    card->addSubview(controller->view());
    controller->updateViewConstraints();
    window->layoutIfNeeded();
    EXPECT_EQ(rowAt(controller, 0)->frame(), (Rect{0.0, 0.0, 320.0, 78.5}));
    EXPECT_EQ(rowAt(controller, 1)->frame(), (Rect{0.0, 78.5, 320.0, 78.5}));
    EXPECT_EQ(controller->singleLabelView()->frame(), (Rect{0.0, 157.0, 320.0, 48.0}));
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, LaidOut_Locating_LabelFillsTheNinetyPoints) {
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, 320.0, 500.0});
    const auto controller = makeController({lostAnn()});
    controller->view()->setFrame({0.0, 0.0, 320.0, controller->desiredHeightForWidth(320.0)});
    window->addSubview(controller->view());
    window->layoutIfNeeded();
    EXPECT_EQ(controller->singleLabelView()->frame(), (Rect{0.0, 0.0, 320.0, 90.0}));
    EXPECT_EQ(controller->singleLabelView()->label()->frame(), (Rect{15.0, 15.0, 290.0, 60.0}));
}

// Life

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, UpdatedBeforeItsViewIsLoaded_DrawsLater) {
    const auto controller = makeController({});
    update(controller, {ann()});
    EXPECT_EQ(controller->friendViews().size(), 1u);
    EXPECT_EQ(controller->desiredHeightForWidth(320.0), 78.5);
    EXPECT_EQ(texts(controller), Strings{"Ann"});
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, UserMoves_DistancesFollow) {
    locationManagers->cached = position(51.001, -1.0);
    const auto controller = makeController({ann()});
    controller->desiredHeightForWidth(320.0);
    EXPECT_EQ(rowAt(controller, 0)->distanceLabel()->text(), "111 m");
    locationManagers->made.back()->deliver(position(51.002, -1.0));
    EXPECT_EQ(rowAt(controller, 0)->distanceLabel()->text(), "222 m");
}

TEST_F(VAKTRMultipleLocationsSnippetControllerTest, Dropped_LeaksNothing) {
    auto controller = makeController({ann(), bo()}, "incomplete=1&");
    controller->desiredHeightForWidth(320.0);
    controller->viewWillAppear(false);
    const std::weak_ptr<Controller> gone = controller;
    const std::weak_ptr<View> row = shown(controller)[0];
    const std::weak_ptr<View> label = controller->singleLabelView();
    controller.reset();
    EXPECT_TRUE(gone.expired());
    EXPECT_TRUE(label.expired());
    // The avatar's deferred step holds its row until it has run.
    EXPECT_FALSE(row.expired());
    time->advance(0.1);
    EXPECT_TRUE(row.expired());
    // The account context alone listens, for redirects, as long as there is a platform.
    EXPECT_EQ(platform->notificationCenter->observerCount(), 1u);
    time->advance(30.0);
    EXPECT_EQ(time->pendingTimers(), 0u);
}

}  // namespace ktr
