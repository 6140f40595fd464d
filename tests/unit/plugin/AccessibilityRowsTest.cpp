#include "plugin/KTRSnippetControllerFactory.h"
#include "plugin/VAKTRGeoFenceSnippetController.h"
#include "plugin/VAKTRLocationSnippetController.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "plugin/VAKTRVisibilityController.h"
#include "tests/support/FakeHost.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"
#include "tests/support/Results.h"
#include "views/accessibility/KTRAXVelaFenceView.h"
#include "views/accessibility/KTRAXVelaFriendView.h"

// Which rows the controllers make of which text size, and what becomes of them.

namespace ktr {

using namespace platform;
using test::listOf;
using test::placedFriend;
using test::proximitySnippet;

namespace {

constexpr double kWidth = 375.0;
constexpr ContentSizeCategory kSizes[] = {ContentSizeCategory::AX1, ContentSizeCategory::AX2, ContentSizeCategory::AX3,
                                          ContentSizeCategory::AX4, ContentSizeCategory::AX5};

template <class Row>
bool isLarge(const std::shared_ptr<View>& view) {
    return std::dynamic_pointer_cast<Row>(view) != nullptr;
}

}  // namespace

class AccessibilityRowsTest : public test::PlatformTest {
  protected:
    template <class Controller>
    std::shared_ptr<Controller> shown(const std::shared_ptr<VASnippet>& snippet) {
        const auto controller = create<Controller>(&Controller::initWithCueObject, snippet);
        controller->setDelegate(host_);
        controller->setCurrentWidth(kWidth);
        controller->loadView();
        return controller;
    }
    static std::shared_ptr<VAKtrLocation> ann() { return placedFriend("Ann", "ann@example.org"); }
    static std::shared_ptr<VAKtrLocation> bo() { return placedFriend("Bo", "bo@example.org"); }
    static std::shared_ptr<VASnippet> one() {
        const auto snippet = proximitySnippet({ann()});
        snippet->proximity = std::nullopt;
        return snippet;
    }
    static std::shared_ptr<VASnippet> several() { return proximitySnippet({ann(), bo()}); }
    static std::shared_ptr<VASnippet> fence() {
        const auto snippet = std::make_shared<VAKtrGeoFenceSnippet>();
        snippet->cueKtrGeoFence = test::fenceOf(ann()->friend_, VAKtrGeoFenceTriggerOnDepartureValue, "Pier");
        return snippet;
    }
    static std::shared_ptr<VASnippet> sharing(bool visible) {
        const auto snippet = std::make_shared<VAKtrVisibilityView>();
        snippet->visible = visible;
        return snippet;
    }

    std::shared_ptr<test::FakeHost> host_ = std::make_shared<test::FakeHost>();
};

TEST_F(AccessibilityRowsTest, EveryKindOfAnswer_HasItsLargeRowsAtEverySize) {
    for (const auto size : kSizes) {
        device->category = size;
        EXPECT_TRUE(isLarge<KTRAXVelaFriendView>(shown<VAKTRLocationSnippetController>(one())->friendView()));
        EXPECT_TRUE(isLarge<KTRAXVelaFenceView>(shown<VAKTRGeoFenceSnippetController>(fence())->fenceView()));
        EXPECT_TRUE(isLarge<KTRAXVelaFriendView>(shown<VAKTRVisibilityController>(sharing(true))->friendView()));
        const auto list = shown<VAKTRMultipleLocationsSnippetController>(several());
        ASSERT_EQ(list->friendViews().size(), 2u);
        for (const auto& [handle, row] : list->friendViews()) {
            EXPECT_TRUE(isLarge<KTRAXVelaFriendView>(row));
        }
        time->runUntilIdle(1.0);
        for (const auto& [handle, row] : list->friendViews()) {
            EXPECT_NE(std::dynamic_pointer_cast<KTRAXVelaFriendView>(row)->imageView()->image(), nullptr);
        }
    }
    device->category = ContentSizeCategory::XXXL;
    EXPECT_FALSE(isLarge<KTRAXVelaFriendView>(shown<VAKTRLocationSnippetController>(one())->friendView()));
    EXPECT_FALSE(isLarge<KTRAXVelaFenceView>(shown<VAKTRGeoFenceSnippetController>(fence())->fenceView()));
    EXPECT_FALSE(isLarge<KTRAXVelaFriendView>(shown<VAKTRVisibilityController>(sharing(true))->friendView()));
}

TEST_F(AccessibilityRowsTest, SingleLocation_ALaterTextSizeDoesNotSwapTheRow) {
    device->category = ContentSizeCategory::AX2;
    const auto controller = shown<VAKTRLocationSnippetController>(one());
    const auto row = controller->friendView();
    device->category = ContentSizeCategory::L;
    controller->reloadData();
    controller->locationsUpdated(test::resultOf(listOf({bo()})));
    EXPECT_EQ(controller->friendView(), row);
    EXPECT_TRUE(controller->axSize());
    EXPECT_TRUE(isLarge<KTRAXVelaFriendView>(row));
}

TEST_F(AccessibilityRowsTest, List_MayMixKinds_IsKept) {
    device->category = ContentSizeCategory::AX2;
    const auto controller = shown<VAKTRMultipleLocationsSnippetController>(proximitySnippet({ann()}));
    device->category = ContentSizeCategory::L;
    controller->locationsUpdated(test::resultOf(listOf({ann(), bo()})));
    EXPECT_TRUE(isLarge<KTRAXVelaFriendView>(controller->friendViews().at("ann@example.org")));
    EXPECT_FALSE(isLarge<KTRAXVelaFriendView>(controller->friendViews().at("bo@example.org")));
}

TEST_F(AccessibilityRowsTest, Geofence_TheLargeRowStartsWithoutHeight) {
    EXPECT_EQ(shown<VAKTRGeoFenceSnippetController>(fence())->fenceView()->frame(), (Rect{0.0, 0.0, kWidth, 100.0}));
    device->category = ContentSizeCategory::AX1;
    EXPECT_EQ(shown<VAKTRGeoFenceSnippetController>(fence())->fenceView()->frame(), (Rect{0.0, 0.0, kWidth, 0.0}));
}

TEST_F(AccessibilityRowsTest, Images_TellTheHostOnceEach_ButTheUsersOwnRowTellsNobody_IsKept) {
    device->category = ContentSizeCategory::AX1;
    const auto list = shown<VAKTRMultipleLocationsSnippetController>(several());
    time->runUntilIdle(1.0);
    EXPECT_EQ(host_->heightChanges.size(), 2u);
    host_->heightChanges.clear();
    const auto single = shown<VAKTRLocationSnippetController>(one());
    const auto fenced = shown<VAKTRGeoFenceSnippetController>(fence());
    time->runUntilIdle(1.0);
    EXPECT_EQ(host_->heightChanges.size(), 2u);
    host_->heightChanges.clear();
    const auto own = shown<VAKTRVisibilityController>(sharing(true));
    time->runUntilIdle(1.0);
    EXPECT_TRUE(host_->heightChanges.empty());
    EXPECT_NE(std::dynamic_pointer_cast<KTRAXVelaFriendView>(own->friendView())->imageView()->image(), nullptr);
}

TEST_F(AccessibilityRowsTest, Rows_AreTiedToControllerAndRefreshController) {
    device->category = ContentSizeCategory::AX1;
    const auto list = shown<VAKTRMultipleLocationsSnippetController>(several());
    const auto row = list->friendViews().at("ann@example.org");
    EXPECT_EQ(row->viewDelegate(), list);
    EXPECT_EQ(row->urlHandler(), list);
    EXPECT_EQ(row->currentLocationDelegate(), list->refreshController());
    EXPECT_FALSE(row->translatesAutoresizingMaskIntoConstraints());
    EXPECT_EQ(row->frame().width, kWidth);
    EXPECT_TRUE(row->separatorEnabled());
    EXPECT_FALSE(list->friendViews().at("bo@example.org")->separatorEnabled());
    EXPECT_TRUE(list->friendViews().at("bo@example.org")->separatorView()->hidden());
}

TEST_F(AccessibilityRowsTest, HeightOfAList_IsTheSumOfItsRows) {
    device->category = ContentSizeCategory::AX1;
    const auto list = shown<VAKTRMultipleLocationsSnippetController>(several());
    double sum = 0.0;
    for (const auto& [handle, row] : list->friendViews()) {
        sum += row->estimagedHeightForView();
    }
    EXPECT_DOUBLE_EQ(list->desiredHeightForWidth(kWidth), sum);
}

TEST_F(AccessibilityRowsTest, HiddenUser_HasARowWithoutASeparator) {
    device->category = ContentSizeCategory::AX1;
    const auto controller = shown<VAKTRVisibilityController>(sharing(false));
    EXPECT_FALSE(controller->friendView()->separatorEnabled());
    EXPECT_TRUE(controller->friendView()->separatorView()->hidden());
    EXPECT_EQ(controller->mapView(), nullptr);
    EXPECT_DOUBLE_EQ(controller->desiredHeightForWidth(kWidth), controller->friendView()->estimagedHeightForView());
}

TEST_F(AccessibilityRowsTest, EndOfRefreshing_RendersTheRowAnew) {
    device->category = ContentSizeCategory::AX1;
    auto lost = test::friendByEmail("Ann", "ann@example.org");
    localization->set("org.ktr.snippets", "LOCATING", "Looking");
    localization->set("org.ktr.snippets", "NO_LOCATION", "Not found");
    const auto snippet = proximitySnippet({lost});
    snippet->proximity = std::nullopt;
    const auto controller = shown<VAKTRLocationSnippetController>(snippet);
    const auto row = std::dynamic_pointer_cast<KTRAXVelaFriendView>(controller->friendView());
    time->runPosted();
    const auto image = row->imageView()->image();
    EXPECT_EQ(row->attributedStringForView().text(), "Ann\nLooking");
    controller->refreshCancelled();
    time->runPosted();
    EXPECT_EQ(row->attributedStringForView().text(), "Ann\nNot found");
    EXPECT_NE(row->imageView()->image(), image);
    EXPECT_FALSE(controller->refreshingCancelled());
}

}  // namespace ktr
