#include "tests/contract/LocationManagerContract.h"

namespace ktr::test {

using Latitudes = std::vector<double>;

TEST_P(LocationManagerContract, BeforeAFix_ThereIsNoLocationAndNothingIsDelivered) {
    EXPECT_EQ(manager->location(), nullptr);
    manager->startUpdatingLocation();
    EXPECT_EQ(listener->latitudes, Latitudes{});
}

TEST_P(LocationManagerContract, PositionsAreDeliveredWhileUpdatesRun) {
    manager->startUpdatingLocation();
    subject.next();
    subject.next();
    EXPECT_EQ(listener->latitudes, (Latitudes{54.5, 54.50005}));
}

TEST_P(LocationManagerContract, WithoutUpdates_NothingIsDeliveredButTheNewestPositionIsKnown) {
    subject.next();
    subject.next();
    EXPECT_EQ(listener->latitudes, Latitudes{});
    ASSERT_NE(manager->location(), nullptr);
    EXPECT_EQ(manager->location()->coordinate().latitude, 54.50005);
}

TEST_P(LocationManagerContract, AfterStopping_NothingIsDelivered) {
    manager->startUpdatingLocation();
    subject.next();
    manager->stopUpdatingLocation();
    subject.next();
    EXPECT_EQ(listener->latitudes, (Latitudes{54.5}));
}

TEST_P(LocationManagerContract, TheDistanceFilter_CountsFromTheLastPositionDelivered) {
    manager->setDistanceFilter(10.0);
    manager->startUpdatingLocation();
    subject.next();
    subject.next();  // 5.6 m on
    EXPECT_EQ(listener->latitudes, (Latitudes{54.5}));
    EXPECT_EQ(manager->location()->coordinate().latitude, 54.50005);
    subject.next();  // 22 m on
    EXPECT_EQ(listener->latitudes, (Latitudes{54.5, 54.5002}));
}

TEST_P(LocationManagerContract, TheDelegateIsNotKeptAlive) {
    const std::weak_ptr<Listener> held = listener;
    listener = nullptr;
    EXPECT_TRUE(held.expired());
    manager->startUpdatingLocation();
    subject.next();
    EXPECT_NE(manager->location(), nullptr);
}

INSTANTIATE_TEST_SUITE_P(FakeLocationManagers, LocationManagerContract,
                         ::testing::Values(LocationManagerCase{
                             "FakeLocationManagers",
                             [](PlatformTest& test, const LocationFixes& fixes) {
                                 const auto factory = test.locationManagers;
                                 auto at = std::make_shared<std::size_t>(0);
                                 return LocationManagersUnderTest{
                                     factory, [factory, fixes, at] {
                                         const auto position =
                                             std::make_shared<platform::PlatformLocation>(fixes[(*at)++]);
                                         for (const auto& made : factory->made) {
                                             made->deliver(position);
                                         }
                                     }};
                             }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
