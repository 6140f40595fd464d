#include "linux/locale/IcuDistanceCalculatorFactory.h"
#include "linux/positions/GeographicLibGeodesy.h"
#include "tests/contract/DistanceCalculatorContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(IcuDistanceCalculator, DistanceCalculatorContract,
                         ::testing::Values(DistanceCalculatorCase{
                             "IcuDistanceCalculator",
                             [] {
                                 return std::make_shared<linux_::IcuDistanceCalculatorFactory>(
                                     std::make_shared<linux_::GeographicLibGeodesy>());
                             }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
