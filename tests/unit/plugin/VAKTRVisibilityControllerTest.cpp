#include "plugin/VAKTRVisibilityController.h"

#include "platform/ui/Accessibility.h"
#include "platform/ui/Window.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

// The controller by itself; its polling is in LiveVisibilityTest.cpp.

namespace ktr {

using namespace platform;
using test::friendByEmail;

class VAKTRVisibilityControllerTest : public test::PlatformTest {
  protected:
    using Controller = VAKTRVisibilityController;
    static constexpr double kWidth = 375.0;

    VAKTRVisibilityControllerTest() {
        localization->set("org.ktr.snippets", "HIDDEN_LOCATION", "Hidden");
        localization->set("org.ktr.snippets", "LOCATING", "Locating");
    }

    static std::shared_ptr<Controller> make(bool visible, const std::optional<std::string>& context = std::nullopt) {
        const auto snippet = std::make_shared<VAKtrVisibilityView>();
        snippet->visible = visible;
        if (context) {
            snippet->searchContext = Url("ktrServerContext://serverContext?" + *context);
        }
        return create<Controller>(&Controller::initWithCueObject, snippet);
    }
    /// As a host brings it up.
    std::shared_ptr<Controller> shown(bool visible, const std::optional<std::string>& context = std::nullopt) {
        const auto controller = make(visible, context);
        controller->setDelegate(host_);
        controller->desiredHeightForWidth(kWidth);
        return controller;
    }
    static std::shared_ptr<KTRVAMyLocation> me(const std::string& name) {
        std::shared_ptr<VAKtrLocation> place =
            test::placed(friendByEmail(name, "me@example.org"), 51.5, -2.5, "Springfield");
        return KTRVAMyLocation::myLocation(true, place, std::nullopt);
    }
    static std::shared_ptr<const ServiceResult> resultWith(const std::shared_ptr<KTRVAMyLocation>& record) {
        return std::make_shared<const ServiceResult>(ServiceResult{Dictionary{{"statusCode", 200}}, record});
    }

    std::shared_ptr<test::FakeHost> host_ = std::make_shared<test::FakeHost>();
};

// Creation

TEST_F(VAKTRVisibilityControllerTest, Creation_ReadsWhetherTheUserIsSeen) {
    for (const bool visible : {true, false}) {
        log->clear();
        const auto controller = make(visible);
        EXPECT_EQ(controller->isVisible(), visible);
        EXPECT_TRUE(log->has(LogLevel::Default, visible ? "is visible init called: 1" : "is visible init called: 0"));
        ASSERT_NE(controller->myLocation(), nullptr);
        EXPECT_EQ(controller->myLocation()->isVisible(), visible);
        EXPECT_FALSE(controller->myLocation()->hasCoordinate());
        EXPECT_FALSE(controller->disableSelection());
    }
}

TEST_F(VAKTRVisibilityControllerTest, PreferredEmailOfTheContext_IsTheRecordsHandle) {
    const auto controller = make(true, "preferredEmail=other@example.org&");
    EXPECT_EQ(controller->myLocation()->friendEmail(), "other@example.org");
}

TEST_F(VAKTRVisibilityControllerTest, ContextWithoutPreferredEmail_LeavesTheAccountsName) {
    EXPECT_EQ(make(true, "clientId=abc&")->myLocation()->friendEmail(), "ann@example.org");
    EXPECT_EQ(make(false)->myLocation()->friendEmail(), "ann@example.org");
}

TEST_F(VAKTRVisibilityControllerTest, EmptyPreferredEmail_CountsAsGiven_IsKept) {
    const auto controller = make(true, "preferredEmail=&");
    EXPECT_NE(controller->myLocation()->friendEmail(), "ann@example.org");
}

TEST_F(VAKTRVisibilityControllerTest, AccountOfAPhoneNumber_IsLookedUpByIt) {
    accounts->account->user = "+441632960018";
    contacts->contacts = {test::contactWith("Mara", "", "+441632960018")};
    const auto controller = make(true);
    EXPECT_EQ(controller->myLocation()->friendPhone(), "+441632960018");
    EXPECT_FALSE(controller->myLocation()->friendEmail().has_value());
}

TEST_F(VAKTRVisibilityControllerTest, SnippetOfAnotherKind_IsHidden) {
    const auto controller =
        create<Controller>(&Controller::initWithCueObject, std::make_shared<VAKtrGeoFenceSnippet>());
    ASSERT_NE(controller, nullptr);
    EXPECT_FALSE(controller->isVisible());
}

// The host's delegate

TEST_F(VAKTRVisibilityControllerTest, Visible_RefreshesItsOwnPlace) {
    const auto controller = make(true);
    controller->setDelegate(host_);
    EXPECT_TRUE(controller->refreshController()->isVisibilityRefresh());
}

TEST_F(VAKTRVisibilityControllerTest, Hidden_GoesOnAskingForFriends_IsKept) {
    const auto controller = make(false);
    controller->setDelegate(host_);
    ASSERT_NE(controller->refreshController(), nullptr);
    EXPECT_FALSE(controller->refreshController()->isVisibilityRefresh());
}

TEST_F(VAKTRVisibilityControllerTest, DelegateNone_ChangesNothing) {
    const auto controller = make(true);
    controller->setDelegate(nullptr);
    EXPECT_EQ(controller->refreshController(), nullptr);
    controller->setDelegate(host_);
    controller->refreshController()->setIsVisibilityRefresh(false);
    controller->setDelegate(nullptr);
    EXPECT_FALSE(controller->refreshController()->isVisibilityRefresh());
}

// The view

TEST_F(VAKTRVisibilityControllerTest, Hidden_IsOneRowWithoutSeparatorAndNoMap) {
    const auto controller = shown(false);
    const auto row = controller->friendView();
    EXPECT_EQ(controller->containerView()->arrangedSubviews(), std::vector<std::shared_ptr<View>>{row});
    EXPECT_EQ(controller->mapView(), nullptr);
    EXPECT_FALSE(row->separatorEnabled());
    EXPECT_TRUE(row->separatorView()->hidden());
    EXPECT_EQ(row->locationLabel()->text(), "Hidden");
    EXPECT_TRUE(row->isVisibility());
}

TEST_F(VAKTRVisibilityControllerTest, Visible_IsTheRowAboveTheMap) {
    const auto controller = shown(true);
    const auto row = controller->friendView();
    const auto map = controller->mapView();
    EXPECT_EQ(controller->containerView()->arrangedSubviews(), (std::vector<std::shared_ptr<View>>{row, map}));
    EXPECT_TRUE(row->isVisibility());
    EXPECT_EQ(row->urlHandler(), controller);
    EXPECT_EQ(row->currentLocationDelegate(), controller->refreshController());
    EXPECT_EQ(row->location(), controller->myLocation());
    EXPECT_FALSE(row->separatorView()->hidden());
    EXPECT_FALSE(row->translatesAutoresizingMaskIntoConstraints());
    EXPECT_TRUE(map->isVisibilityMap());
    EXPECT_EQ(map->urlHandler(), controller);
    EXPECT_EQ(map->currentLocationDelegate(), controller->refreshController());
    EXPECT_EQ(map->location(), controller->myLocation());
    EXPECT_EQ(map->frame(), (Rect{0.0, 0.0, kWidth, 219.0}));
    EXPECT_FALSE(map->translatesAutoresizingMaskIntoConstraints());
}

TEST_F(VAKTRVisibilityControllerTest, RowStartsWithoutHeight) {
    const auto controller = make(false);
    controller->setCurrentWidth(kWidth);
    controller->loadView();
    EXPECT_EQ(controller->friendView()->frame(), (Rect{0.0, 0.0, kWidth, 0.0}));
}

TEST_F(VAKTRVisibilityControllerTest, RowHasNoViewDelegate_IsKept) {
    EXPECT_EQ(shown(true)->friendView()->viewDelegate(), nullptr);
    EXPECT_EQ(shown(false)->friendView()->viewDelegate(), nullptr);
}

TEST_F(VAKTRVisibilityControllerTest, SharingIsSaidWithoutSeeing) {
    localization->set("org.ktr.snippets", "ACCESSIBILITY_SHARED_LOCATION", "Friends see you");
    localization->set("org.ktr.snippets", "ACCESSIBILITY_ROW_PARTS", "%1$@; %2$@");
    const auto spoken = [](Controller& controller) {
        const auto tree = accessibilityTree(controller.view(), false);
        return tree.children.empty() ? "nothing" : tree.children.front().text;
    };
    const auto visible = shown(true);
    visible->view()->setFrame({0.0, 0.0, kWidth, 300.0});
    visible->view()->layoutIfNeeded();
    EXPECT_EQ(spoken(*visible), "ann@example.org; Friends see you; Locating");
    const auto hidden = shown(false);
    hidden->view()->setFrame({0.0, 0.0, kWidth, 80.0});
    hidden->view()->layoutIfNeeded();
    EXPECT_EQ(spoken(*hidden), "ann@example.org; Hidden") << "the place text says it";
    EXPECT_EQ(hidden->friendView()->locationLabel()->accessibilityText(), "Hidden");
}

TEST_F(VAKTRVisibilityControllerTest, MapShowsTheUser) {
    locationManagers->cached = position(51.5, -2.5);
    const auto map = shown(true)->mapView()->mapView();
    ASSERT_TRUE(map->requestedRegion().has_value());
    EXPECT_EQ(map->requestedRegion()->center, (Coordinate{51.5, -2.5}));
    EXPECT_EQ(map->requestedRegion()->span.latitudeDelta, 0.0008);
    EXPECT_EQ(map->requestedRegion()->span.longitudeDelta, 0.0008);
    EXPECT_TRUE(map->annotations().empty()) << "no friend's pin";
    EXPECT_TRUE(map->overlays().empty());
}

TEST_F(VAKTRVisibilityControllerTest, MapOfAnUnknownPlace_IsGivenNoRegion) {
    EXPECT_FALSE(shown(true)->mapView()->mapView()->requestedRegion().has_value());
    locationManagers->cached = position(0.0, 0.0);
    EXPECT_FALSE(shown(true)->mapView()->mapView()->requestedRegion().has_value());
}

// Height

TEST_F(VAKTRVisibilityControllerTest, Height_Hidden_IsTheRows) {
    const auto controller = make(false);
    const double height = controller->desiredHeightForWidth(kWidth);
    ASSERT_NE(controller->containerView(), nullptr) << "loads the view";
    EXPECT_EQ(controller->currentWidth(), kWidth);
    EXPECT_EQ(height, controller->friendView()->estimagedHeightForView());
    EXPECT_GT(height, 0.0);
}

TEST_F(VAKTRVisibilityControllerTest, Height_Visible_IsTheRowsAndTheMaps) {
    const auto controller = make(true);
    const double height = controller->desiredHeightForWidth(kWidth);
    EXPECT_EQ(height, controller->friendView()->estimagedHeightForView() + 219.0);
    device->idiom = UserInterfaceIdiom::Tablet;
    EXPECT_EQ(controller->desiredHeightForWidth(kWidth), height + 170.0);
}

TEST_F(VAKTRVisibilityControllerTest, Height_OfNothingWhileHidden_IsAMapAndNinety_IsKept) {
    const auto controller = make(false);
    controller->VAKTRBaseSnippetController::loadView();
    EXPECT_EQ(controller->desiredHeightForWidth(kWidth), 219.0 + 90.0);
    EXPECT_EQ(controller->friendView(), nullptr);
}

TEST_F(VAKTRVisibilityControllerTest, Height_LaysTheContainerOutInAWindow) {
    const auto controller = shown(true);
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, kWidth, 600.0});
    window->addSubview(controller->view());
    controller->view()->setFrame({0.0, 0.0, kWidth, controller->desiredHeightForWidth(kWidth)});
    controller->desiredHeightForWidth(kWidth);
    EXPECT_EQ(controller->friendView()->frame().width, kWidth);
    EXPECT_EQ(controller->mapView()->frame().height, 219.0);
}

// What arrives

TEST_F(VAKTRVisibilityControllerTest, Visible_EachResultBringsTheNewRecord) {
    const auto controller = shown(true);
    for (const auto& name : {"Ann", "Ann Marsh"}) {
        const auto record = me(name);
        log->clear();
        controller->locationsUpdated(resultWith(record));
        EXPECT_EQ(controller->myLocation(), record);
        EXPECT_EQ(controller->friendView()->location(), record);
        EXPECT_EQ(controller->friendView()->nameLabel()->text(), name);
        EXPECT_EQ(controller->mapView()->location(), nullptr);
        EXPECT_TRUE(log->has(LogLevel::Default, "visibility_vela_location: <KTRVAMyLocation visible>"));
    }
    EXPECT_EQ(host_->heightChanges, (std::vector<bool>{true, true}));
}

TEST_F(VAKTRVisibilityControllerTest, Visible_WholeListBecomesRecordsThatNobodyReads_IsKept) {
    const auto controller = shown(true);
    controller->locationsUpdated(resultWith(me("Ann")));
    ASSERT_EQ(controller->locations().size(), 2U);
    EXPECT_EQ(controller->locations()[0]->velaLocation(), nullptr);
    ASSERT_EQ(controller->friends().size(), 1U);
    EXPECT_EQ(controller->friends()[0]->fullName, "Ann");
}

TEST_F(VAKTRVisibilityControllerTest, Visible_EmptyListOrNone_IsNoRecord) {
    for (const auto& result : {std::make_shared<const ServiceResult>(), std::shared_ptr<const ServiceResult>()}) {
        const auto controller = shown(true);
        controller->locationsUpdated(result);
        EXPECT_EQ(controller->myLocation(), nullptr);
        EXPECT_EQ(controller->friendView()->location(), nullptr);
        EXPECT_EQ(controller->friendView()->nameLabel()->text(), "");
        EXPECT_TRUE(controller->friends().empty());
        EXPECT_EQ(host_->heightChanges.size(), 1U);
        EXPECT_TRUE(log->has(LogLevel::Default, "visibility_vela_location: (null)"));
        EXPECT_GT(controller->desiredHeightForWidth(kWidth), 219.0) << "the row keeps its height";
        host_->heightChanges.clear();
    }
}

TEST_F(VAKTRVisibilityControllerTest, Visible_LastThingThatIsNoRecord_IsNoRecord) {
    const auto controller = shown(true);
    controller->locationsUpdated(
        std::make_shared<const ServiceResult>(ServiceResult{me("Ann"), friendByEmail("Bo", "bo@example.org")}));
    EXPECT_EQ(controller->myLocation(), nullptr);
    EXPECT_EQ(controller->locations().size(), 2U);
}

TEST_F(VAKTRVisibilityControllerTest, Hidden_KeepsItsRecordWhateverArrives) {
    const auto controller = shown(false);
    const auto record = controller->myLocation();
    controller->locationsUpdated(resultWith(me("Ann")));
    EXPECT_EQ(controller->myLocation(), record);
    EXPECT_EQ(controller->friendView()->location(), record);
    EXPECT_EQ(controller->friendView()->locationLabel()->text(), "Hidden");
    EXPECT_EQ(host_->heightChanges, std::vector<bool>{true});
    EXPECT_FALSE(log->has(LogLevel::Default, "visibility_vela_location: <KTRVAMyLocation visible>"));
}

TEST_F(VAKTRVisibilityControllerTest, BeforeTheViewIsLoaded_RecordsAreKept) {
    const auto controller = make(true);
    const auto record = me("Ann");
    controller->locationsUpdated(resultWith(record));
    controller->refreshCancelled();
    EXPECT_EQ(controller->myLocation(), record);
    EXPECT_EQ(controller->containerView(), nullptr);
}

// Reloads and the end

TEST_F(VAKTRVisibilityControllerTest, Reload_MapNamesNobodyAnyMore_IsKept) {
    const auto controller = shown(true);
    EXPECT_EQ(controller->mapView()->urlForTouch(), Url("wayloc://friend/ann@example.org"));
    controller->reloadData();
    EXPECT_EQ(controller->mapView()->location(), nullptr);
    EXPECT_EQ(controller->mapView()->urlForTouch(), Url("wayloc://friend/(null)"));
    EXPECT_EQ(controller->friendView()->urlForTouch(), Url("wayloc://friend/ann@example.org"));
}

TEST_F(VAKTRVisibilityControllerTest, Reload_ShowsWhatTheRecordNowSays) {
    const auto controller = shown(true);
    controller->setMyLocation(me("Mara"));
    EXPECT_NE(controller->friendView()->nameLabel()->text(), "Mara");
    controller->reloadData();
    EXPECT_EQ(controller->friendView()->nameLabel()->text(), "Mara");
}

TEST_F(VAKTRVisibilityControllerTest, EndOfRefreshing_RedrawsAndLeavesTheFlag_IsKept) {
    const auto controller = shown(true);
    controller->setMyLocation(me("Mara"));
    controller->refreshCancelled();
    EXPECT_FALSE(controller->refreshingCancelled());
    EXPECT_EQ(controller->friendView()->nameLabel()->text(), "Mara");
    EXPECT_EQ(controller->mapView()->location(), nullptr);
}

TEST_F(VAKTRVisibilityControllerTest, EndOfRefreshing_RowGoesOnLocating_IsKept) {
    const auto controller = shown(true);
    controller->refreshCancelled();
    EXPECT_TRUE(controller->friendView()->isRefreshingLocation());
    EXPECT_EQ(controller->friendView()->locationLabel()->text(), "Locating");
}

// What the refresh controller asks

TEST_F(VAKTRVisibilityControllerTest, Friends_AreTheUserAlone) {
    const auto controller = make(false);
    ASSERT_EQ(controller->friends().size(), 1U);
    EXPECT_EQ(controller->friends()[0], controller->myLocation()->velaLocation()->friend_->object);
}

TEST_F(VAKTRVisibilityControllerTest, Friends_WithoutAPerson_AreNobody) {
    const auto controller = make(true);
    controller->setMyLocation(nullptr);
    EXPECT_TRUE(controller->friends().empty());
    auto nobody = std::make_shared<VAKtrLocation>();
    controller->setMyLocation(KTRVAMyLocation::myLocation(true, nobody, std::nullopt));
    EXPECT_TRUE(controller->friends().empty());
    nobody->friend_ = std::make_shared<VAPersonAttribute>();
    EXPECT_TRUE(controller->friends().empty());
}

TEST_F(VAKTRVisibilityControllerTest, Proximity_IsAlwaysNone) {
    const auto controller = make(true);
    controller->setProximity("dinner");
    EXPECT_FALSE(controller->proximity().has_value());
}

TEST_F(VAKTRVisibilityControllerTest, Taps_OpenTheUser) {
    const auto controller = shown(true);
    controller->friendView()->viewTouched();
    controller->mapView()->viewTouched();
    const Url own("wayloc://friend/ann@example.org");
    EXPECT_EQ(host_->opened, (std::vector<Url>{own, own}));
}

TEST_F(VAKTRVisibilityControllerTest, Fields_HaveSetters) {
    const auto controller = make(false);
    controller->setIsVisible(true);
    controller->setDisableSelection(true);
    EXPECT_TRUE(controller->isVisible());
    EXPECT_TRUE(controller->disableSelection());
    const auto other = shown(true);
    controller->setFriendView(other->friendView());
    controller->setMapView(other->mapView());
    EXPECT_EQ(controller->friendView(), other->friendView());
    EXPECT_EQ(controller->mapView(), other->mapView());
}

TEST_F(VAKTRVisibilityControllerTest, DelegateDropsTheControllerWhileAsked) {
    struct DroppingHost : test::FakeHost {
        std::shared_ptr<Controller> held;
        std::shared_ptr<Bundle> effectiveBundleForLocation(HostSnippetViewController&) override {
            held.reset();
            return bundle;
        }
    };
    const auto host = std::make_shared<DroppingHost>();
    host->held = make(true);
    const std::weak_ptr<Controller> gone = host->held;
    host->held->setDelegate(host);
    EXPECT_TRUE(gone.expired());
}

}  // namespace ktr
