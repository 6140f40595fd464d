#include "service/DecimalDigits.h"

#include <gtest/gtest.h>

namespace ktr::test {
namespace {

TEST(DecimalDigitsTest, DigitsOfEveryScript) {
    for (const char32_t digit : U"0٠۹०๙０９𝟎𝟿🯰🯹") {
        if (digit != U'\0') {
            EXPECT_TRUE(isDecimalDigit(digit)) << static_cast<unsigned>(digit);
        }
    }
}

TEST(DecimalDigitsTest, WhatOnlyLooksLikeDigits) {
    for (const char32_t other : U"/:a²½①Ⅳ一\uFFFD\U0010FFFF") {
        EXPECT_FALSE(isDecimalDigit(other)) << static_cast<unsigned>(other);
    }
}

}  // namespace
}  // namespace ktr::test
