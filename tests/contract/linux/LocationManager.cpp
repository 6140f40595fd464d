#include "linux/services/GeographicLibGeodesy.h"
#include "linux/services/ScenarioLocationManagerFactory.h"
#include "tests/contract/LocationManagerContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(ScenarioLocationManager, LocationManagerContract,
                         ::testing::Values(LocationManagerCase{
                             "ScenarioLocationManager",
                             [](PlatformTest& test, const LocationFixes& fixes) {
                                 std::vector<linux_::TimedPosition> walk;
                                 for (const auto& fix : fixes) {
                                     walk.push_back({static_cast<double>(walk.size() + 1), fix});
                                 }
                                 return LocationManagersUnderTest{
                                     std::make_shared<linux_::ScenarioLocationManagerFactory>(
                                         walk, test.time, test.time, std::make_shared<linux_::GeographicLibGeodesy>()),
                                     [time = test.time] { time->advance(1.0); }};
                             }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
