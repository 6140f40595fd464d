#include "service/RefreshController.h"

#include <cmath>
#include <vector>

#include "tests/support/PlatformTest.h"

namespace ktr::test {
namespace {

/// Says what a test tells it, so that the threshold can be met exactly.
struct StatedGeodesy : SphereGeodesy {
    double metres = 0.0;
    double distance(const platform::Coordinate&, const platform::Coordinate&) const override { return metres; }
};

class RefreshControllerTest : public PlatformTest {
  protected:
    RefreshControllerTest() { platform->geodesy = stated; }

    std::shared_ptr<RefreshController> make(const std::shared_ptr<platform::Bundle>& bundle = nullptr) {
        return platform::create<RefreshController>(&RefreshController::initWithBundle, bundle);
    }
    FakeLocationManager& manager() { return *locationManagers->made.back(); }
    /// Moves the user by this many metres.
    std::shared_ptr<platform::PlatformLocation> move(RefreshController& controller, double metres) {
        stated->metres = metres;
        auto next = position(48.0, 11.0);
        controller.didUpdateLocations(manager(), {next});
        return next;
    }

    std::shared_ptr<StatedGeodesy> stated = std::make_shared<StatedGeodesy>();
    std::vector<platform::Notification> heard;
    platform::NotificationCenter::Token token = platform->notificationCenter->addObserver(
        "ktrCurrentLocationUpdated", [this](const platform::Notification& n) { heard.push_back(n); });
};

TEST_F(RefreshControllerTest, StartsUpdatesInTheNameOfItsBundle) {
    const auto bundle = std::make_shared<platform::Bundle>("org.example.host");
    const auto controller = make(bundle);
    ASSERT_EQ(locationManagers->made.size(), 1U);
    EXPECT_EQ(manager().bundle, bundle);
    EXPECT_EQ(manager().delegate(), controller);
    EXPECT_EQ(manager().desiredAccuracy, platform::kLocationAccuracyNearestTenMeters);
    EXPECT_EQ(manager().distanceFilter, 10.0);
    EXPECT_TRUE(manager().updating);
    EXPECT_EQ(controller->locationManager(), locationManagers->made.back());
}

TEST_F(RefreshControllerTest, TakesOverThePositionThatIsKnown) {
    locationManagers->cached = position(1.0, 2.0);
    EXPECT_EQ(make()->currentLocation(), locationManagers->cached);
    locationManagers->cached = nullptr;
    EXPECT_EQ(make()->currentLocation(), nullptr);
}

TEST_F(RefreshControllerTest, WithoutABundleItStillAsksForPositions) {
    const auto controller = make(nullptr);
    EXPECT_EQ(manager().bundle, nullptr);
    EXPECT_TRUE(manager().updating);
}

TEST_F(RefreshControllerTest, AMoveOfMoreThanTenMetresIsTold) {
    const auto controller = make();
    move(*controller, 0.0);
    const auto moved = move(*controller, 10.01);
    ASSERT_EQ(heard.size(), 1U);
    EXPECT_EQ(heard[0].sender, controller);
    EXPECT_EQ(controller->currentLocation(), moved);
}

TEST_F(RefreshControllerTest, AMoveOfTenMetresIsKeptToItself) {
    const auto controller = make();
    move(*controller, 0.0);
    const auto moved = move(*controller, 10.0);
    EXPECT_TRUE(heard.empty());
    EXPECT_EQ(controller->currentLocation(), moved);
}

TEST_F(RefreshControllerTest, TheFirstPositionIsKeptToItself) {
    const auto controller = make();
    move(*controller, 5000.0);
    EXPECT_TRUE(heard.empty());
    EXPECT_NE(controller->currentLocation(), nullptr);
}

TEST_F(RefreshControllerTest, ADistanceThatCannotBeMeasuredIsKeptToItself) {
    const auto controller = make();
    move(*controller, 0.0);
    move(*controller, std::nan(""));
    EXPECT_TRUE(heard.empty());
}

TEST_F(RefreshControllerTest, TheLastPositionOfAListCounts) {
    const auto controller = make();
    const auto newest = position(3.0, 3.0);
    controller->didUpdateLocations(manager(), {position(1.0, 1.0), position(2.0, 2.0), newest});
    EXPECT_EQ(controller->currentLocation(), newest);
}

TEST_F(RefreshControllerTest, AnEmptyListKeepsThePosition) {
    const auto controller = make();
    const auto known = move(*controller, 0.0);
    controller->didUpdateLocations(manager(), {});
    EXPECT_EQ(controller->currentLocation(), known);
}

TEST_F(RefreshControllerTest, ListenersSeeTheNewPosition) {
    const auto controller = make();
    move(*controller, 0.0);
    std::shared_ptr<platform::PlatformLocation> seen;
    const auto listener = platform->notificationCenter->addObserver(
        kCurrentLocationUpdatedNotification,
        [&](const platform::Notification&) { seen = controller->currentLocation(); });
    const auto moved = move(*controller, 11.0);
    EXPECT_EQ(seen, moved);
}

TEST_F(RefreshControllerTest, PositionsFromTheManagerArrive) {
    platform->geodesy = geodesy;
    const auto controller = make();
    manager().deliver(position(48.0, 11.0));
    manager().deliver(position(48.1, 11.0));
    EXPECT_EQ(controller->currentLocation()->coordinate().latitude, 48.1);
    EXPECT_EQ(heard.size(), 1U);
}

TEST_F(RefreshControllerTest, TheEndStopsUpdates) {
    auto controller = make();
    const auto last = locationManagers->made.back();
    controller.reset();
    EXPECT_FALSE(last->updating);
    EXPECT_EQ(last->delegate(), nullptr);
    last->deliver(position(1.0, 1.0));
}

}  // namespace
}  // namespace ktr::test
