#include "tests/contract/NumberFormatterContract.h"

#include <cstdint>
#include <limits>

#include "tests/support/Doubles.h"

namespace ktr::test {

TEST_P(NumberFormatterContract, Decimals_AreRead) {
    EXPECT_EQ(numbers->numberFromString("310"), 310.0);
    EXPECT_EQ(numbers->numberFromString("1234.5625"), 1234.5625);
    EXPECT_EQ(numbers->numberFromString("-0.25"), -0.25);
    EXPECT_EQ(numbers->numberFromString("0"), 0.0);
}

TEST_P(NumberFormatterContract, ManyDigits_KeepTheirPrecision) {
    EXPECT_EQ(numbers->numberFromString("1234567.1234567"), 1234567.1234567);
}

TEST_P(NumberFormatterContract, WhatIsNotWhollyANumber_GivesNone) {
    for (const char* text : {"", " ", "abc", "12 m", "12m", "1.2.3", "--3", "NaN", "inf", "0x10", "12 ", " 12"}) {
        EXPECT_EQ(numbers->numberFromString(text), std::nullopt) << "\"" << text << "\"";
    }
}

TEST_P(NumberFormatterContract, Integers_AreWrittenWithoutGrouping) {
    EXPECT_EQ(numbers->plainStringFromInteger(0), "0");
    EXPECT_EQ(numbers->plainStringFromInteger(59), "59");
    EXPECT_EQ(numbers->plainStringFromInteger(1234567), "1234567");
    EXPECT_EQ(numbers->plainStringFromInteger(-12), "-12");
    EXPECT_EQ(numbers->plainStringFromInteger(std::numeric_limits<std::int64_t>::max()), "9223372036854775807");
}

INSTANTIATE_TEST_SUITE_P(FakeNumbers, NumberFormatterContract,
                         ::testing::Values(NumberFormatterCase{"FakeNumbers",
                                                               [] { return std::make_shared<FakeNumbers>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
