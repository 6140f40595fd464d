#include "model/NumberComparison.h"

#include <gtest/gtest.h>

#include <cmath>

namespace ktr::test {
namespace {

TEST(NumberComparisonTest, CloseIsAtMostTheThreshold) {
    EXPECT_TRUE(isCloseToNumber(37.0000005, 37.0, 0.000001));
    EXPECT_TRUE(isCloseToNumber(37.0, 37.0000005, 0.000001));
    EXPECT_FALSE(isCloseToNumber(37.000002, 37.0, 0.000001));
    EXPECT_TRUE(isCloseToNumber(1.5, 1.0, 0.5)) << "the threshold itself is close";
    EXPECT_TRUE(isCloseToNumber(1.0, 1.0, 0.0));
}

TEST(NumberComparisonTest, NothingIsCloseToNaNOrWithinLessThanNothing) {
    EXPECT_FALSE(isCloseToNumber(std::nan(""), 1.0, 10.0));
    EXPECT_FALSE(isCloseToNumber(1.0, 1.0, -1.0));
}

}  // namespace
}  // namespace ktr::test
