#include "linux/positions/SourceLocationManager.h"

#include <cmath>

#include "linux/positions/SourceLocationManagerFactory.h"
#include "tests/support/PlatformTest.h"

namespace ktr::test {

using linux_::PositionHub;
using linux_::PositionSource;

class SourceLocationManagerTest : public PlatformTest {
  protected:
    struct Source : PositionSource {
        std::vector<double> starts;
        int stops = 0;
        void start(double accuracy) override { starts.push_back(accuracy); }
        void stop() override { ++stops; }
        void put(double latitude, double accuracy = 5.0) {
            platform::PlatformLocation::Fix fix;
            fix.coordinate = {latitude, -1.0};
            fix.horizontalAccuracy = accuracy;
            tell(fix);
        }
    };
    struct Listener : platform::PlatformLocationManagerDelegate {
        std::vector<double> latitudes;
        void didUpdateLocations(platform::PlatformLocationManager&, const platform::PlatformLocations& all) override {
            latitudes.push_back(all.back()->coordinate().latitude);
        }
    };

    SourceLocationManagerTest() {
        auto made = std::make_unique<Source>();
        source = made.get();
        factory = std::make_unique<linux_::SourceLocationManagerFactory>(
            std::make_shared<PositionHub>(std::move(made), time, geodesy));
    }

    Source* source;
    std::unique_ptr<linux_::SourceLocationManagerFactory> factory;
};

TEST_F(SourceLocationManagerTest, WhatIsNoPosition_IsHandedToNobody) {
    auto manager = factory->makeManager(nullptr);
    const auto listener = std::make_shared<Listener>();
    manager->setDelegate(listener);
    manager->startUpdatingLocation();
    for (const double accuracy : {-1.0, 1e300, std::nan("")}) {
        source->put(50.0, accuracy);
    }
    EXPECT_TRUE(listener->latitudes.empty());
    EXPECT_EQ(manager->location(), nullptr);
    source->put(51.0);
    EXPECT_EQ(listener->latitudes, std::vector<double>{51.0});
}

TEST_F(SourceLocationManagerTest, Source_RunsWhileAnybodyWantsIt_AtTheBestAccuracy) {
    auto one = factory->makeManager(nullptr);
    auto other = factory->makeManager(nullptr);
    EXPECT_TRUE(source->starts.empty());
    one->setDesiredAccuracy(1000.0);
    one->startUpdatingLocation();
    one->startUpdatingLocation();
    EXPECT_EQ(source->starts, (std::vector<double>{1000.0}));
    other->startUpdatingLocation();
    EXPECT_EQ(source->starts, (std::vector<double>{1000.0, 10.0}));
    other->stopUpdatingLocation();
    EXPECT_EQ(source->starts.back(), 1000.0);
    EXPECT_EQ(source->stops, 0);
    one.reset();
    EXPECT_EQ(source->stops, 1) << "a manager that is gone wants nothing";
}

TEST_F(SourceLocationManagerTest, KnownPosition_IsDeliveredOnALaterTurn) {
    auto one = factory->makeManager(nullptr);
    one->startUpdatingLocation();
    source->put(51.0);
    auto other = factory->makeManager(nullptr);
    const auto listener = std::make_shared<Listener>();
    other->setDelegate(listener);
    ASSERT_NE(other->location(), nullptr);
    EXPECT_EQ(other->location()->coordinate().latitude, 51.0);
    other->startUpdatingLocation();
    EXPECT_TRUE(listener->latitudes.empty());
    time->runPosted();
    EXPECT_EQ(listener->latitudes, (std::vector<double>{51.0}));
    source->put(51.0);
    EXPECT_EQ(listener->latitudes.size(), 2U) << "without a filter everything is delivered";
    other->stopUpdatingLocation();
    source->put(52.0);
    EXPECT_EQ(listener->latitudes.size(), 2U);
    EXPECT_EQ(other->location()->coordinate().latitude, 52.0);
}

TEST_F(SourceLocationManagerTest, NonsenseOfASource_IsDropped) {
    auto manager = factory->makeManager(nullptr);
    manager->startUpdatingLocation();
    source->put(91.0);
    source->put(std::nan(""));
    source->put(51.0, std::nan(""));
    EXPECT_EQ(manager->location(), nullptr);
}

}  // namespace ktr::test
