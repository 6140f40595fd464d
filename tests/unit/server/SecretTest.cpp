#include "server/store/Secret.h"

#include <gtest/gtest.h>

namespace ktr::test {

using server::Secret;

TEST(SecretTest, Secret_Has128RandomBits) {
    const auto one = Secret::make();
    ASSERT_TRUE(one);
    EXPECT_EQ(one->size(), 26U);
    EXPECT_NE(one, Secret::make());
}

TEST(SecretTest, Number_IsAboveZero_AndAnotherEachTime) {
    const auto one = Secret::number();
    EXPECT_GT(one, 0);
    EXPECT_NE(one, Secret::number());
}

}  // namespace ktr::test
