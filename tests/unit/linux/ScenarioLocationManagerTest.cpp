#include "linux/positions/ScenarioLocationManager.h"

#include <gtest/gtest.h>

#include "linux/positions/ScenarioLocationManagerFactory.h"
#include "tests/support/PlatformTest.h"

namespace ktr::linux_ {

namespace {

class ScenarioLocationManagerTest : public test::PlatformTest {
  protected:
    struct Listener : platform::PlatformLocationManagerDelegate {
        std::vector<double> latitudes;
        bool stopAtFirst = false;
        void didUpdateLocations(platform::PlatformLocationManager& manager,
                                const platform::PlatformLocations& locations) override {
            latitudes.push_back(locations.back()->coordinate().latitude);
            if (stopAtFirst) {
                manager.stopUpdatingLocation();
            }
        }
    };
    static TimedPosition at(double seconds, double latitude) {
        TimedPosition position;
        position.seconds = seconds;
        position.fix.coordinate = {latitude, -1.2};
        return position;
    }
    std::shared_ptr<platform::PlatformLocationManager> manager(std::vector<TimedPosition> positions) {
        ScenarioLocationManagerFactory factory(std::move(positions), time, time, geodesy);
        auto made = factory.makeManager(nullptr);
        made->setDelegate(listener);
        return made;
    }
    std::shared_ptr<Listener> listener = std::make_shared<Listener>();
};

using Latitudes = std::vector<double>;

}  // namespace

TEST_F(ScenarioLocationManagerTest, AFixedPosition_IsKnownAtOnceAndDeliveredOnALaterTurn) {
    const auto fixed = manager({at(0.0, 54.5)});
    ASSERT_NE(fixed->location(), nullptr);
    EXPECT_EQ(fixed->location()->coordinate().latitude, 54.5);
    fixed->startUpdatingLocation();
    EXPECT_EQ(listener->latitudes, Latitudes{});
    time->advance(0.0);
    EXPECT_EQ(listener->latitudes, Latitudes{54.5});
    time->advance(3600.0);
    EXPECT_EQ(listener->latitudes, Latitudes{54.5});
}

TEST_F(ScenarioLocationManagerTest, PositionsInAnyOrder_AreDeliveredByTime) {
    const auto walking = manager({at(60.0, 54.7), at(-5.0, 54.5), at(30.0, 54.6)});
    walking->startUpdatingLocation();
    time->advance(29.0);
    EXPECT_EQ(listener->latitudes, Latitudes{54.5});
    time->advance(31.0);
    EXPECT_EQ(listener->latitudes, (Latitudes{54.5, 54.6, 54.7}));
}

TEST_F(ScenarioLocationManagerTest, StartingLate_DeliversTheNewestKnownOnly) {
    const auto walking = manager({at(0.0, 54.5), at(10.0, 54.6), at(20.0, 54.7)});
    time->advance(15.0);
    walking->startUpdatingLocation();
    time->advance(0.0);
    EXPECT_EQ(listener->latitudes, Latitudes{54.6});
    time->advance(10.0);
    EXPECT_EQ(listener->latitudes, (Latitudes{54.6, 54.7}));
}

TEST_F(ScenarioLocationManagerTest, ADelegateMayStopTheUpdates) {
    listener->stopAtFirst = true;
    const auto walking = manager({at(0.0, 54.5), at(10.0, 54.6)});
    walking->startUpdatingLocation();
    time->advance(20.0);
    EXPECT_EQ(listener->latitudes, Latitudes{54.5});
}

TEST_F(ScenarioLocationManagerTest, StartingTwice_DeliversOnce) {
    const auto fixed = manager({at(0.0, 54.5)});
    fixed->startUpdatingLocation();
    fixed->startUpdatingLocation();
    time->advance(1.0);
    EXPECT_EQ(listener->latitudes, Latitudes{54.5});
}

TEST_F(ScenarioLocationManagerTest, StartingAgain_DeliversTheNewestAgain) {
    const auto fixed = manager({at(0.0, 54.5)});
    fixed->setDistanceFilter(10.0);
    fixed->startUpdatingLocation();
    time->advance(1.0);
    fixed->stopUpdatingLocation();
    fixed->startUpdatingLocation();
    time->advance(1.0);
    EXPECT_EQ(listener->latitudes, (Latitudes{54.5, 54.5}));
}

TEST_F(ScenarioLocationManagerTest, AManagerThatIsGone_LeavesNoTimer) {
    auto walking = manager({at(10.0, 54.6)});
    walking->startUpdatingLocation();
    EXPECT_EQ(time->pendingTimers(), 1u);
    walking = nullptr;
    EXPECT_EQ(time->pendingTimers(), 0u);
}

TEST_F(ScenarioLocationManagerTest, APositionWithoutTime_GetsTheMomentItBecameKnown) {
    const auto walking = manager({at(30.0, 54.5)});
    EXPECT_EQ(walking->location(), nullptr);
    time->advance(45.0);
    ASSERT_NE(walking->location(), nullptr);
    EXPECT_EQ(walking->location()->fix().timestamp, platform::Date{kNoon + 30.0});
    EXPECT_EQ(walking->location(), walking->location());
}

TEST_F(ScenarioLocationManagerTest, WithoutPositions_NothingIsDelivered) {
    const auto nowhere = manager({});
    nowhere->startUpdatingLocation();
    time->advance(100.0);
    EXPECT_EQ(listener->latitudes, Latitudes{});
    EXPECT_EQ(nowhere->location(), nullptr);
}

}  // namespace ktr::linux_
