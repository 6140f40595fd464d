#include "linux/positions/GeographicLibGeodesy.h"
#include "linux/positions/ScenarioLocationManagerFactory.h"
#include "linux/positions/SourceLocationManagerFactory.h"
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

namespace {

/// A source that is told where to be.
struct ScriptedSource : linux_::PositionSource {
    void start(double) override {}
    void stop() override {}
    void put(const platform::PlatformLocation::Fix& fix) const { tell(fix); }
};

LocationManagersUnderTest onASource(PlatformTest& test, const LocationFixes& fixes) {
    auto source = std::make_unique<ScriptedSource>();
    const auto* told = source.get();
    const auto hub = std::make_shared<linux_::PositionHub>(std::move(source), test.time,
                                                           std::make_shared<linux_::GeographicLibGeodesy>());
    return {std::make_shared<linux_::SourceLocationManagerFactory>(hub),
            [hub, told, fixes, time = test.time, index = std::size_t{0}]() mutable {
                told->put(fixes.at(index++));
                time->runPosted();
            }};
}

}  // namespace

INSTANTIATE_TEST_SUITE_P(SourceLocationManager, LocationManagerContract,
                         ::testing::Values(LocationManagerCase{"SourceLocationManager", onASource}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
