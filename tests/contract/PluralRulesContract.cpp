#include "tests/contract/PluralRulesContract.h"

#include "tests/support/Doubles.h"

namespace ktr::test {

TEST_P(PluralRulesContract, English_HasOneAndOther) {
    EXPECT_EQ(rules->category("1", "en"), "one");
    for (const char* number : {"0", "2", "11", "21", "59"}) {
        EXPECT_EQ(rules->category(number, "en"), "other") << number;
    }
}

TEST_P(PluralRulesContract, WhatIsNoNumber_IsAnOther) {
    for (const char* number : {"", "one", "1 min", " 1", "(null)"}) {
        EXPECT_EQ(rules->category(number, "en"), "other") << number;
    }
}

INSTANTIATE_TEST_SUITE_P(FakePlurals, PluralRulesContract,
                         ::testing::Values(PluralRulesCase{"FakePlurals",
                                                           [] { return std::make_shared<FakePlurals>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
