#include "linux/positions/GeographicLibGeodesy.h"
#include "tests/contract/GeodesyContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(GeographicLib, GeodesyContract,
                         ::testing::Values(GeodesyCase{
                             "GeographicLib", [] { return std::make_shared<linux_::GeographicLibGeodesy>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
