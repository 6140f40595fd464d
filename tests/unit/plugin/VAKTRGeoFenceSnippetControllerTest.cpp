#include "plugin/VAKTRGeoFenceSnippetController.h"

#include <cmath>

#include "platform/ui/Window.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

namespace ktr {

using namespace platform;
using test::fenceOf;
using test::friendByEmail;

class VAKTRGeoFenceSnippetControllerTest : public test::PlatformTest {
  protected:
    using Controller = VAKTRGeoFenceSnippetController;
    static constexpr double kWidth = 375.0;

    VAKTRGeoFenceSnippetControllerTest() {
        localization->set("org.ktr.snippets", "LEAVING_LABEL", "When leaving %@");
        localization->set("org.ktr.snippets", "ARRIVING_LABEL_ABSOLUTE", "When arriving");
    }

    static std::shared_ptr<VAKtrGeoFence> annsFence(double radius = 100.0) {
        auto fence =
            fenceOf(friendByEmail("Ann", "ann@example.org")->friend_, VAKtrGeoFenceTriggerOnDepartureValue, "The Yard");
        fence->location->accuracy = radius;
        return fence;
    }
    static std::shared_ptr<Controller> make(std::shared_ptr<VAKtrGeoFence> fence,
                                            const std::optional<std::string>& context = std::nullopt) {
        const auto snippet = std::make_shared<VAKtrGeoFenceSnippet>();
        snippet->cueKtrGeoFence = std::move(fence);
        if (context) {
            snippet->searchContext = Url("ktrServerContext://serverContext?" + *context);
        }
        return create<Controller>(&Controller::initWithCueObject, snippet);
    }
    /// As a host brings it up.
    std::shared_ptr<Controller> shown(std::shared_ptr<VAKtrGeoFence> fence,
                                      const std::optional<std::string>& context = std::nullopt) {
        const auto controller = make(std::move(fence), context);
        controller->setDelegate(host_);
        controller->setCurrentWidth(kWidth);
        controller->loadView();
        return controller;
    }

    std::shared_ptr<test::FakeHost> host_ = std::make_shared<test::FakeHost>();
};

// Creation

TEST_F(VAKTRGeoFenceSnippetControllerTest, Creation_TakesTheFenceAsItStands) {
    const auto fence = annsFence();
    const auto controller = make(fence, "clientId=abc&");
    EXPECT_EQ(controller->cueKtrGeoFence(), fence);
    EXPECT_EQ(controller->clientId(), "abc");
    EXPECT_EQ(controller->fenceView(), nullptr);
    EXPECT_EQ(controller->mapView(), nullptr);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Zoom_OfTheContext_IsReadInSinglePrecision) {
    EXPECT_EQ(make(annsFence(), "geoFenceZoomLevel=0.2&")->zoomLevel(), static_cast<double>(0.2F));
    EXPECT_NE(make(annsFence(), "geoFenceZoomLevel=0.2&")->zoomLevel(), 0.2);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Zoom_ContextWithoutOne_IsTheUsualInSinglePrecision_IsKept) {
    EXPECT_EQ(make(annsFence(), "zoomLevel=0.3&")->zoomLevel(), static_cast<double>(0.0008F));
    EXPECT_NE(make(annsFence(), "")->zoomLevel(), 0.0008) << "widened, not rounded back";
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Zoom_PresentButUnreadable_IsZero) {
    EXPECT_EQ(make(annsFence(), "geoFenceZoomLevel=near&")->zoomLevel(), 0.0);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Zoom_WithoutAContext_StaysZero) {
    EXPECT_EQ(make(annsFence())->zoomLevel(), 0.0);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, SnippetOfAnotherKind_HasNoFence) {
    const auto controller = create<Controller>(&Controller::initWithCueObject, std::make_shared<VAKtrVisibilityView>());
    ASSERT_NE(controller, nullptr);
    EXPECT_EQ(controller->cueKtrGeoFence(), nullptr);
}

// The view

TEST_F(VAKTRGeoFenceSnippetControllerTest, View_IsTheRowAboveTheMap) {
    const auto controller = shown(annsFence(), "");
    const auto row = controller->fenceView();
    const auto map = controller->mapView();
    EXPECT_EQ(controller->containerView()->arrangedSubviews(), (std::vector<std::shared_ptr<View>>{row, map}));
    EXPECT_EQ(row->viewDelegate(), controller);
    EXPECT_EQ(row->urlHandler(), controller);
    EXPECT_EQ(row->currentLocationDelegate(), controller->refreshController());
    EXPECT_EQ(row->geoFence(), controller->cueKtrGeoFence());
    EXPECT_EQ(row->nameLabel()->text(), "Ann");
    EXPECT_EQ(row->fenceLabel()->text(), "When leaving The Yard");
    EXPECT_EQ(row->frame(), (Rect{0.0, 0.0, kWidth, 100.0}));
    EXPECT_EQ(map->urlHandler(), controller);
    EXPECT_EQ(map->geoFence(), controller->cueKtrGeoFence());
    EXPECT_EQ(map->zoomLevel(), controller->zoomLevel());
    EXPECT_EQ(map->frame(), (Rect{0.0, 0.0, kWidth, KTRDynVelaMapView::mapHeight()}));
    EXPECT_EQ(map->location(), nullptr);
    EXPECT_FALSE(map->isVisibilityMap());
    EXPECT_FALSE(row->translatesAutoresizingMaskIntoConstraints());
    EXPECT_FALSE(map->translatesAutoresizingMaskIntoConstraints());
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, MapIsNotToldWhereTheUserIs_IsKept) {
    const auto controller = shown(annsFence());
    ASSERT_NE(controller->refreshController(), nullptr);
    EXPECT_EQ(controller->mapView()->currentLocationDelegate(), nullptr);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, ZoomIsThereWhenTheFenceIsDrawn) {
    // A fence of 50 m is smaller than the usual zoom: had the zoom come later, its 50 m would be shown.
    const auto map = shown(annsFence(50.0), "")->mapView()->mapView();
    ASSERT_TRUE(map->requestedRegion().has_value());
    EXPECT_EQ(map->requestedRegion()->span.latitudeDelta, static_cast<double>(0.0008F));
    EXPECT_EQ(map->requestedRegion()->span.longitudeDelta, static_cast<double>(0.0008F));
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, FencesOfAllSizes_SpanTheRadiusOrTheZoom_IsKept) {
    constexpr double kMetresADegree = 111194.9;  // of the sphere that the tests measure on
    for (const double radius : {50.0, 88.0, 100.0, 250.0, 1000.0, 5000.0}) {
        const auto controller = shown(annsFence(radius), "");
        const auto map = controller->mapView()->mapView();
        ASSERT_TRUE(map->requestedRegion().has_value());
        // The radius, not twice it: the circle may be cut.
        const double degrees = std::max(radius / kMetresADegree, static_cast<double>(0.0008F));
        EXPECT_NEAR(map->requestedRegion()->span.latitudeDelta, degrees, 1e-6) << radius;
        EXPECT_EQ(map->requestedRegion()->center, (Coordinate{51.0, -1.0}));
        ASSERT_EQ(map->overlays().size(), 1U);
        EXPECT_EQ(std::dynamic_pointer_cast<CircleOverlay>(map->overlays()[0])->radius(), radius);
        ASSERT_EQ(map->annotations().size(), 1U);
        const auto pin = std::dynamic_pointer_cast<KTRVAMapAnnotation>(map->annotations()[0]);
        EXPECT_TRUE(pin->isFenceAnnotation());
        EXPECT_EQ(pin->coordinate(), (Coordinate{51.0, -1.0}));
    }
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, NoFence_IsARowOfNobodyAndAMapOfNoPlace) {
    const auto controller = shown(nullptr);
    EXPECT_EQ(controller->fenceView()->nameLabel()->text(), "");
    EXPECT_EQ(controller->fenceView()->fenceLabel()->text(), "When arriving");
    EXPECT_FALSE(controller->fenceView()->urlForTouch().has_value());
    EXPECT_GT(controller->desiredHeightForWidth(kWidth), KTRDynVelaMapView::mapHeight());
}

// Height

TEST_F(VAKTRGeoFenceSnippetControllerTest, Height_IsTheRowsAndTheMaps) {
    const auto controller = shown(annsFence());
    const double row = controller->fenceView()->estimagedHeightForView();
    EXPECT_GT(row, 0.0);
    EXPECT_EQ(controller->desiredHeightForWidth(kWidth), row + 219.0);
    device->idiom = UserInterfaceIdiom::Tablet;
    EXPECT_EQ(controller->desiredHeightForWidth(kWidth), row + 389.0);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Height_BeforeTheViewIsLoaded_DoesNotLoadIt_IsKept) {
    const auto controller = make(annsFence());
    EXPECT_EQ(controller->desiredHeightForWidth(kWidth), KTRDynVelaMapView::mapHeight());
    EXPECT_EQ(controller->currentWidth(), kWidth);
    EXPECT_EQ(controller->containerView(), nullptr);
    EXPECT_EQ(controller->fenceView(), nullptr);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Height_LaysTheContainerOutInAWindow) {
    const auto controller = shown(annsFence());
    const auto window = create<Window>(&Window::initWithFrame, Rect{0.0, 0.0, kWidth, 600.0});
    window->addSubview(controller->view());
    controller->view()->setFrame({0.0, 0.0, kWidth, controller->desiredHeightForWidth(kWidth)});
    const double height = controller->desiredHeightForWidth(kWidth);
    EXPECT_EQ(controller->fenceView()->frame().width, kWidth);
    EXPECT_EQ(controller->mapView()->frame().height, 219.0);
    EXPECT_EQ(height, controller->fenceView()->estimagedHeightForView() + 219.0);
}

// Life

TEST_F(VAKTRGeoFenceSnippetControllerTest, Reload_RedrawsNothing_IsKept) {
    const auto controller = shown(annsFence());
    controller->fenceView()->fenceLabel()->setText("as it was");
    controller->reloadData();
    controller->locationsUpdated(nullptr);
    EXPECT_EQ(controller->fenceView()->fenceLabel()->text(), "as it was");
    EXPECT_EQ(controller->mapView()->mapView()->annotations().size(), 1U);
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, EndOfRefreshing_IsRememberedAsByTheBase) {
    const auto controller = shown(annsFence());
    controller->refreshCancelled();
    EXPECT_TRUE(controller->refreshingCancelled());
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Refreshing_AsksForNobody) {
    const auto controller = shown(annsFence(), "minCallbackIntervalInMS=5000&callbackTimeoutIntervalInMS=60000&");
    EXPECT_TRUE(controller->friends().empty());
    time->advance(5.0);
    ASSERT_EQ(transport->requests.size(), 1U);
    EXPECT_NE(transport->requests[0].path.find("getlocations"), std::string::npos);
    EXPECT_NE(transport->requests[0].body.find(R"("handles":[])"), std::string::npos) << transport->requests[0].body;
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Taps_OpenTheFriend) {
    const auto controller = shown(annsFence());
    controller->fenceView()->viewTouched();
    controller->mapView()->viewTouched();
    const Url friendUrl("wayloc://friend/ann@example.org");
    EXPECT_EQ(host_->opened, (std::vector<Url>{friendUrl, friendUrl}));
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, NoHandle_RowOpensNothingAndTheMapNobody_IsKept) {
    auto fence = annsFence();
    fence->friend_->data = std::nullopt;
    const auto controller = shown(fence);
    controller->fenceView()->viewTouched();
    EXPECT_TRUE(host_->opened.empty());
    controller->mapView()->viewTouched();
    EXPECT_EQ(host_->opened, std::vector<Url>{Url("wayloc://friend/(null)")});
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Fields_HaveSetters) {
    const auto controller = make(nullptr);
    const auto fence = annsFence();
    controller->setCueKtrGeoFence(fence);
    controller->setZoomLevel(0.5);
    EXPECT_EQ(controller->cueKtrGeoFence(), fence);
    EXPECT_EQ(controller->zoomLevel(), 0.5);
    const auto other = shown(fence);
    controller->setFenceView(other->fenceView());
    controller->setMapView(other->mapView());
    EXPECT_EQ(controller->fenceView(), other->fenceView());
    EXPECT_EQ(controller->mapView(), other->mapView());
}

TEST_F(VAKTRGeoFenceSnippetControllerTest, Gone_LeavesNothingBehind) {
    auto controller = shown(annsFence(), "");
    const std::weak_ptr<KTRDynVelaMapView> map = controller->mapView();
    controller.reset();
    time->advance(1.0);
    while (!transport->waiting.empty()) {
        transport->fail(HttpFailure::Network);
    }
    time->runPosted();
    EXPECT_TRUE(map.expired());
}

}  // namespace ktr
