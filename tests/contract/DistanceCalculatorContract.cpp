#include "tests/contract/DistanceCalculatorContract.h"

#include <limits>

namespace ktr::test {

TEST_P(DistanceCalculatorContract, AFewHundredMetres_ReadInMetres) {
    const auto text = calculator->localizedDistance(*position(54.5, -1.2), *position(54.5036, -1.2));
    ASSERT_TRUE(text.has_value());
    EXPECT_NE(text->find("400"), std::string::npos) << *text;
    EXPECT_EQ(text->back(), 'm');
    EXPECT_EQ(text->find("km"), std::string::npos);
}

TEST_P(DistanceCalculatorContract, SomeKilometres_ReadInKilometres) {
    const auto text = calculator->localizedDistance(*position(54.5, -1.2), *position(54.521, -1.2));
    ASSERT_TRUE(text.has_value());
    EXPECT_NE(text->find("2.3"), std::string::npos) << *text;
    EXPECT_NE(text->find("km"), std::string::npos) << *text;
}

TEST_P(DistanceCalculatorContract, TheText_IsOneLine) {
    const auto text = calculator->localizedDistance(*position(54.5, -1.2), *position(54.6, -1.2));
    ASSERT_TRUE(text.has_value());
    EXPECT_EQ(text->find('\n'), std::string::npos);
}

TEST_P(DistanceCalculatorContract, WhatCannotBeMeasured_GivesNone) {
    const auto nowhere = position(std::numeric_limits<double>::quiet_NaN(), 0.0);
    EXPECT_EQ(calculator->localizedDistance(*nowhere, *position(54.5, -1.2)), std::nullopt);
    EXPECT_EQ(calculator->localizedDistance(*position(54.5, -1.2), *nowhere), std::nullopt);
}

TEST_P(DistanceCalculatorContract, TheMetricSystemIsNumberZero) {
    EXPECT_EQ(calculator->measurementSystem(), 0);
}

INSTANTIATE_TEST_SUITE_P(FakeDistanceCalculators, DistanceCalculatorContract,
                         ::testing::Values(DistanceCalculatorCase{
                             "FakeDistanceCalculators", [] { return std::make_shared<FakeDistanceCalculators>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
