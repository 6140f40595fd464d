#include "linux/locale/IcuNumberFormatter.h"
#include "tests/contract/NumberFormatterContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(IcuNumberFormatter, NumberFormatterContract,
                         ::testing::Values(NumberFormatterCase{
                             "IcuNumberFormatter",
                             [] { return std::make_shared<linux_::IcuNumberFormatter>("en-GB"); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
