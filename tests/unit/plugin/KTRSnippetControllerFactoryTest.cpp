#include "plugin/KTRSnippetControllerFactory.h"

#include "plugin/VAKTRGeoFenceSnippetController.h"
#include "plugin/VAKTRLocationSnippetController.h"
#include "plugin/VAKTRMultipleLocationsSnippetController.h"
#include "plugin/VAKTRVisibilityController.h"
#include "tests/support/Friends.h"
#include "tests/support/PlatformTest.h"

namespace ktr {

using namespace platform;
using test::placedFriend;
using test::proximitySnippet;

namespace {

struct DerivedSnippet : VAKtrLocationSnippet {};

struct UnknownObject : AssistantObject {
    std::string description() const override { return "<Unknown>"; }
};

}  // namespace

class KTRSnippetControllerFactoryTest : public test::PlatformTest {
  protected:
    static bool isMultipleLocations(const std::shared_ptr<HostSnippetViewController>& controller) {
        return std::dynamic_pointer_cast<VAKTRMultipleLocationsSnippetController>(controller) != nullptr;
    }

    std::shared_ptr<KTRSnippetControllerFactory> factory_ = std::make_shared<KTRSnippetControllerFactory>();
};

TEST_F(KTRSnippetControllerFactoryTest, LocationsWithProximity_AreMultipleLocations) {
    const auto controller =
        factory_->viewControllerForSnippet(proximitySnippet({placedFriend("Ann", "ann@example.org")}));
    EXPECT_TRUE(isMultipleLocations(controller));
    EXPECT_EQ(controller.use_count(), 1);
}

TEST_F(KTRSnippetControllerFactoryTest, EmptyProximity_IsPresent) {
    const auto snippet = proximitySnippet({});
    snippet->proximity = "";
    EXPECT_TRUE(isMultipleLocations(factory_->viewControllerForSnippet(snippet)));
}

TEST_F(KTRSnippetControllerFactoryTest, NoLocationsAtAll_StillAController) {
    const auto snippet = proximitySnippet({});
    snippet->locations = nullptr;
    EXPECT_TRUE(isMultipleLocations(factory_->viewControllerForSnippet(snippet)));
}

TEST_F(KTRSnippetControllerFactoryTest, Subkind_CountsAsItsKind) {
    const auto snippet = std::make_shared<DerivedSnippet>();
    snippet->proximity = "dinner";
    EXPECT_TRUE(isMultipleLocations(factory_->viewControllerForSnippet(snippet)));
}

TEST_F(KTRSnippetControllerFactoryTest, EachCall_MakesANewController) {
    const auto snippet = proximitySnippet({});
    EXPECT_NE(factory_->viewControllerForSnippet(snippet), factory_->viewControllerForSnippet(snippet));
}

TEST_F(KTRSnippetControllerFactoryTest, LocationsWithoutProximity_AreASingleLocationHoweverMany) {
    const auto snippet = proximitySnippet({placedFriend("Ann", "a@example.org"), placedFriend("Bo", "b@example.org")});
    snippet->proximity = std::nullopt;
    const auto controller = factory_->viewControllerForSnippet(snippet);
    EXPECT_NE(std::dynamic_pointer_cast<VAKTRLocationSnippetController>(controller), nullptr);
    snippet->locations = nullptr;
    EXPECT_NE(factory_->viewControllerForSnippet(snippet), nullptr);
}

TEST_F(KTRSnippetControllerFactoryTest, UnknownKindOrNone_IsNoneAndOneLine) {
    EXPECT_EQ(factory_->viewControllerForSnippet(std::make_shared<UnknownObject>()), nullptr);
    EXPECT_EQ(factory_->viewControllerForSnippet(std::make_shared<VASnippet>()), nullptr);
    log->clear();
    EXPECT_EQ(factory_->viewControllerForSnippet(nullptr), nullptr);
    EXPECT_EQ(log->texts(),
              std::vector<std::string>{"Unrecognized snippet CueObject passed to KTRSnippetControllerFactory: (null)"});
}

TEST_F(KTRSnippetControllerFactoryTest, GeofenceAndVisibility_HaveControllersOfTheirOwn) {
    const auto fence = factory_->viewControllerForSnippet(std::make_shared<VAKtrGeoFenceSnippet>());
    EXPECT_NE(std::dynamic_pointer_cast<VAKTRGeoFenceSnippetController>(fence), nullptr);
    EXPECT_EQ(fence.use_count(), 1);
    const auto visibility = factory_->viewControllerForSnippet(std::make_shared<VAKtrVisibilityView>());
    EXPECT_NE(std::dynamic_pointer_cast<VAKTRVisibilityController>(visibility), nullptr);
    EXPECT_EQ(visibility.use_count(), 1);
    struct DerivedFence : VAKtrGeoFenceSnippet {};
    EXPECT_NE(factory_->viewControllerForSnippet(std::make_shared<DerivedFence>()), nullptr);
}

TEST_F(KTRSnippetControllerFactoryTest, ObjectOfTwoKinds_IsLocationsBeforeVisibilityBeforeGeofence) {
    struct LocatedAndVisible : VAKtrVisibilityView, VAKtrLocationSnippet {};
    struct FencedAndVisible : VAKtrGeoFenceSnippet, VAKtrVisibilityView {};
    const auto both = std::make_shared<LocatedAndVisible>();
    const auto located = std::shared_ptr<AssistantObject>(both, static_cast<VAKtrVisibilityView*>(both.get()));
    EXPECT_NE(std::dynamic_pointer_cast<VAKTRLocationSnippetController>(factory_->viewControllerForSnippet(located)),
              nullptr);
    const auto other = std::make_shared<FencedAndVisible>();
    const auto fenced = std::shared_ptr<AssistantObject>(other, static_cast<VAKtrGeoFenceSnippet*>(other.get()));
    EXPECT_NE(std::dynamic_pointer_cast<VAKTRVisibilityController>(factory_->viewControllerForSnippet(fenced)),
              nullptr);
}

TEST_F(KTRSnippetControllerFactoryTest, EveryTextSize_IsDrawn) {
    for (int size = 0; size <= static_cast<int>(ContentSizeCategory::AX5); ++size) {
        device->category = static_cast<ContentSizeCategory>(size);
        EXPECT_NE(factory_->viewControllerForSnippet(proximitySnippet({})), nullptr) << size;
        EXPECT_NE(factory_->viewControllerForSnippet(std::make_shared<VAKtrGeoFenceSnippet>()), nullptr) << size;
    }
}

TEST_F(KTRSnippetControllerFactoryTest, SpeakableNamespace_IsNoneForEverything) {
    EXPECT_EQ(factory_->speakableNamespaceProviderForCueObject(proximitySnippet({})), nullptr);
    EXPECT_EQ(factory_->speakableNamespaceProviderForCueObject(placedFriend("Ann", "a@example.org")), nullptr);
    EXPECT_EQ(factory_->speakableNamespaceProviderForCueObject(std::make_shared<VAKtrGeoFenceSnippet>()), nullptr);
    EXPECT_EQ(factory_->speakableNamespaceProviderForCueObject(std::make_shared<VAKtrVisibilityView>()), nullptr);
    EXPECT_EQ(factory_->speakableNamespaceProviderForCueObject(std::make_shared<UnknownObject>()), nullptr);
    EXPECT_EQ(factory_->speakableNamespaceProviderForCueObject(nullptr), nullptr);
}

}  // namespace ktr
