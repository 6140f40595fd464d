#include "linux/locale/IcuPluralRules.h"
#include "tests/contract/PluralRulesContract.h"

namespace ktr::test {

INSTANTIATE_TEST_SUITE_P(IcuPluralRules, PluralRulesContract,
                         ::testing::Values(PluralRulesCase{"IcuPluralRules",
                                                           [] { return std::make_shared<linux_::IcuPluralRules>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
