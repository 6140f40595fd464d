#include "plugin/VAKTRLocationSnippetController.h"

#include "platform/ui/Window.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/Results.h"

namespace ktr {

using namespace platform;
using test::friendByEmail;
using test::listOf;
using test::placed;
using test::placedFriend;

class VAKTRLocationSnippetControllerTest : public test::PlatformTest {
  protected:
    using Controller = VAKTRLocationSnippetController;
    static constexpr double kWidth = 375.0;
    /// 0.05 in single precision.
    static constexpr double kUsual = 0.05F;

    static std::shared_ptr<Controller> make(LocationList locations,
                                            const std::optional<std::string>& context = std::nullopt) {
        auto snippet = test::proximitySnippet(std::move(locations), context);
        snippet->proximity = std::nullopt;
        return create<Controller>(&Controller::initWithCueObject, snippet);
    }
    /// As a host brings it up.
    std::shared_ptr<Controller> shown(LocationList locations,
                                      const std::optional<std::string>& context = std::nullopt) {
        const auto controller = make(std::move(locations), context);
        controller->setDelegate(host_);
        controller->setCurrentWidth(kWidth);
        controller->loadView();
        return controller;
    }
    static std::shared_ptr<VAKtrLocation> ann() { return placedFriend("Ann", "ann@example.org"); }
    static std::shared_ptr<VAKtrLocation> bo() { return placedFriend("Bo", "bo@example.org"); }
    static std::shared_ptr<VAKtrLocation> lost(const std::string& name) {
        return friendByEmail(name, name + "@example.org");
    }

    std::shared_ptr<test::FakeHost> host_ = std::make_shared<test::FakeHost>();
};

// Creation

TEST_F(VAKTRLocationSnippetControllerTest, NoContext_NoZoom) {
    const auto controller = shown({ann()});
    EXPECT_EQ(controller->zoomLevel(), 0.0);
    EXPECT_EQ(controller->mapView()->zoomLevel(), 0.0);
    EXPECT_FALSE(controller->displayShowAllRow());
}

TEST_F(VAKTRLocationSnippetControllerTest, ContextWithoutZoom_IsTheUsualOneInSinglePrecision) {
    const auto controller = shown({ann()}, "clientId=c&");
    EXPECT_EQ(controller->zoomLevel(), kUsual);
    EXPECT_NE(controller->zoomLevel(), 0.05);
    EXPECT_EQ(controller->mapView()->zoomLevel(), kUsual);
}

TEST_F(VAKTRLocationSnippetControllerTest, Zoom_IsReadInSinglePrecision) {
    EXPECT_EQ(shown({ann()}, "zoomLevel=0.2&")->mapView()->zoomLevel(), static_cast<double>(0.2F));
    EXPECT_EQ(make({ann()}, "zoomLevel=far&")->zoomLevel(), 0.0);
    EXPECT_EQ(make({ann()}, "zoomLevel=-1.5&")->zoomLevel(), -1.5);
}

TEST_F(VAKTRLocationSnippetControllerTest, Incomplete_IsReadButDrawsNoRow) {
    const auto controller = shown({ann()}, "incomplete=1&");
    EXPECT_TRUE(controller->displayShowAllRow());
    EXPECT_EQ(controller->containerView()->arrangedSubviews().size(), 2U);
}

// The view

TEST_F(VAKTRLocationSnippetControllerTest, View_IsTheRowAboveTheMap) {
    const auto controller = shown({ann()});
    EXPECT_EQ(controller->containerView()->arrangedSubviews(),
              (std::vector<std::shared_ptr<View>>{controller->friendView(), controller->mapView()}));
    EXPECT_EQ(controller->friendView()->frame().width, kWidth);
    EXPECT_EQ(controller->mapView()->frame().size(), (Size{kWidth, 219.0}));
    EXPECT_EQ(controller->friendView()->viewDelegate(), controller);
    EXPECT_EQ(controller->friendView()->urlHandler(), controller);
    EXPECT_EQ(controller->mapView()->urlHandler(), controller);
    EXPECT_EQ(controller->friendView()->currentLocationDelegate(), controller->refreshController());
    EXPECT_EQ(controller->mapView()->currentLocationDelegate(), controller->refreshController());
    EXPECT_FALSE(controller->friendView()->translatesAutoresizingMaskIntoConstraints());
    EXPECT_FALSE(controller->mapView()->translatesAutoresizingMaskIntoConstraints());
}

TEST_F(VAKTRLocationSnippetControllerTest, SeveralLocations_OnlyTheFirstIsShown) {
    const auto controller = shown({ann(), bo()});
    EXPECT_EQ(controller->friendView()->nameLabel()->text(), "Ann");
    EXPECT_EQ(controller->mapView()->location(), controller->locations()[0]);
    const auto unlucky = shown({lost("Cy"), bo()});
    EXPECT_EQ(unlucky->friendView()->nameLabel()->text(), "Cy");
    EXPECT_FALSE(unlucky->mapView()->mapAnnotation()->hasKnownLocation());
    EXPECT_EQ(unlucky->mapView()->mapView()->requestedRegion(), std::nullopt);
}

TEST_F(VAKTRLocationSnippetControllerTest, NoLocations_StandsEmpty) {
    const auto controller = shown({});
    EXPECT_EQ(controller->friendView()->location(), nullptr);
    EXPECT_EQ(controller->mapView()->location(), nullptr);
    EXPECT_TRUE(controller->mapView()->mapView()->annotations().empty());
    EXPECT_GT(controller->desiredHeightForWidth(kWidth), 219.0);
}

TEST_F(VAKTRLocationSnippetControllerTest, TextSize_IsTakenWhenTheViewLoads) {
    device->category = ContentSizeCategory::AX1;
    const auto controller = shown({ann()});
    EXPECT_TRUE(controller->axSize());
    device->category = ContentSizeCategory::L;
    const auto row = controller->friendView();
    controller->reloadData();
    EXPECT_TRUE(controller->axSize());
    EXPECT_EQ(controller->friendView(), row);
    EXPECT_FALSE(shown({ann()})->axSize());
}

TEST_F(VAKTRLocationSnippetControllerTest, Tap_OpensTheFriend) {
    const auto controller = shown({ann()});
    controller->mapView()->viewTouched();
    EXPECT_EQ(host_->opened, std::vector<Url>{Url("wayloc://friend/ann@example.org")});
}

// Height

TEST_F(VAKTRLocationSnippetControllerTest, Height_IsTheRowsAndTheMaps) {
    const auto controller = make({ann()});
    controller->setDelegate(host_);
    const double height = controller->desiredHeightForWidth(kWidth);
    ASSERT_NE(controller->containerView(), nullptr) << "loads the view";
    EXPECT_EQ(controller->currentWidth(), kWidth);
    EXPECT_GT(controller->friendView()->estimagedHeightForView(), 0.0);
    EXPECT_EQ(height, controller->friendView()->estimagedHeightForView() + 219.0);
    device->idiom = UserInterfaceIdiom::Tablet;
    EXPECT_EQ(controller->desiredHeightForWidth(kWidth), controller->friendView()->estimagedHeightForView() + 389.0);
}

TEST_F(VAKTRLocationSnippetControllerTest, Height_NothingToMeasure_IsTheMapAnd90) {
    struct NoMap : KTRVelaFriendView {
        double estimagedHeightForView() override { return -KTRDynVelaMapView::mapHeight(); }
    };
    const auto controller = shown({ann()});
    controller->setFriendView(create<NoMap>(&NoMap::initWithFrame, Rect{}));
    EXPECT_EQ(controller->desiredHeightForWidth(kWidth), 309.0);
}

TEST_F(VAKTRLocationSnippetControllerTest, Height_LaysTheContainerOutInAWindow) {
    const auto controller = shown({ann()});
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, kWidth, 600.0});
    window->addSubview(controller->view());
    controller->view()->setFrame({0.0, 0.0, kWidth, controller->desiredHeightForWidth(kWidth)});
    controller->desiredHeightForWidth(kWidth);
    EXPECT_EQ(controller->friendView()->frame().width, kWidth);
    EXPECT_EQ(controller->mapView()->frame().height, 219.0);
    EXPECT_EQ(controller->mapView()->frame().y, controller->friendView()->frame().maxY());
}

// Life

TEST_F(VAKTRLocationSnippetControllerTest, NewLocations_MoveThePin) {
    const auto controller = shown({ann()});
    const auto pin = controller->mapView()->mapAnnotation();
    controller->locationsUpdated(test::resultOf(listOf({placed(ann(), 51.5, -1.5, "Shelby")})));
    EXPECT_EQ(controller->friendView()->locationLabel()->text(), "Shelby");
    EXPECT_EQ(controller->mapView()->mapAnnotation(), pin);
    EXPECT_EQ(pin->coordinate(), (Coordinate{51.5, -1.5}));
}

TEST_F(VAKTRLocationSnippetControllerTest, Reload_ShowsOneRecordInBoth) {
    const auto controller = shown({ann()});
    controller->reloadData();
    EXPECT_EQ(controller->friendView()->location(), controller->mapView()->location());
    EXPECT_EQ(controller->mapView()->location(), controller->locations()[0]);
}

TEST_F(VAKTRLocationSnippetControllerTest, EndOfRefreshing_TheRowStopsAndTheFlagStays_IsKept) {
    const auto controller = shown({lost("Ann")});
    EXPECT_TRUE(controller->friendView()->isRefreshingLocation());
    EXPECT_TRUE(controller->isSearching());
    controller->refreshCancelled();
    EXPECT_FALSE(controller->friendView()->isRefreshingLocation());
    EXPECT_FALSE(controller->refreshingCancelled());
    EXPECT_FALSE(controller->isSearching());
    EXPECT_EQ(controller->mapView()->location(), controller->locations()[0]);
}

TEST_F(VAKTRLocationSnippetControllerTest, Searching_WhileTheShownFriendHasNoPlace) {
    EXPECT_FALSE(make({lost("Ann")})->isSearching());
    EXPECT_TRUE(shown({lost("Ann"), bo()})->isSearching());
    EXPECT_TRUE(shown({placed(lost("Ann"), 0.0, 0.0)})->isSearching());
    EXPECT_FALSE(shown({ann()})->isSearching());
    EXPECT_FALSE(shown({})->isSearching());
    EXPECT_FALSE(shown({placed(lost("Ann"), 51.48, 0.0)})->isSearching()) << "on the zeroth meridian";
    EXPECT_FALSE(shown({placed(lost("Ann"), 0.0, 32.5)})->isSearching()) << "on the equator";
    const auto named = lost("Ann");
    named->label = "Work";
    EXPECT_FALSE(shown({named})->isSearching()) << "known by its name";
}

TEST_F(VAKTRLocationSnippetControllerTest, EndOfRefreshing_BeforeTheViewIsLoaded) {
    const auto controller = make({ann()});
    controller->refreshCancelled();
    EXPECT_FALSE(controller->refreshingCancelled());
    EXPECT_EQ(controller->friendView(), nullptr);
}

TEST_F(VAKTRLocationSnippetControllerTest, Appearing_StartsTheReloadsAndDisappearingEndsThem) {
    const auto controller = shown({ann()}, "clientId=c&");
    controller->viewWillAppear(false);
    const auto reloads = controller->reloadTimer();
    ASSERT_NE(reloads, nullptr);
    EXPECT_TRUE(reloads->isValid());
    controller->viewWillDisappear(false);
    EXPECT_EQ(controller->reloadTimer(), nullptr);
    EXPECT_FALSE(reloads->isValid());
}

// What is known

TEST_F(VAKTRLocationSnippetControllerTest, EmptyLocations_AreThoseWithoutACoordinate) {
    EXPECT_TRUE(make({})->allEmptyLocations());
    EXPECT_TRUE(make({lost("Ann")})->allEmptyLocations());
    EXPECT_FALSE(make({lost("Ann"), bo()})->allEmptyLocations());
}

TEST_F(VAKTRLocationSnippetControllerTest, LocatingFriends_NeedsAQuestionAboutSeveral) {
    EXPECT_FALSE(make({})->showLocatingFriends());
    const auto several = create<Controller>(&Controller::initWithCueObject, test::proximitySnippet({lost("Ann")}));
    EXPECT_TRUE(several->showLocatingFriends());
    const auto known = create<Controller>(&Controller::initWithCueObject, test::proximitySnippet({ann()}));
    EXPECT_FALSE(known->showLocatingFriends());
}

TEST_F(VAKTRLocationSnippetControllerTest, LocationsWithCoordinates_KeepTheirOrder) {
    const auto controller = make({bo(), lost("Cy"), ann()});
    const auto known = controller->proximityLocationsWithCoordinates();
    ASSERT_EQ(known.size(), 2U);
    EXPECT_EQ(known[0], controller->locations()[0]);
    EXPECT_EQ(known[1], controller->locations()[2]);
}

}  // namespace ktr
