#include "platform/client/HttpHeaders.h"

#include <gtest/gtest.h>

namespace ktr::platform {
namespace {

TEST(HttpHeadersTest, SetOverwritesWhateverTheCase) {
    HttpHeaders headers{{"Accept", "text/plain"}, {"X-One", "1"}};
    headers.set("ACCEPT", "application/json");
    ASSERT_EQ(headers.size(), 2U);
    EXPECT_EQ(headers.begin()->first, "ACCEPT");
    EXPECT_EQ(headers.begin()->second, "application/json");
}

TEST(HttpHeadersTest, ValueIsFoundWhateverTheCase) {
    const HttpHeaders headers{{"X-One", "1"}};
    EXPECT_EQ(headers.value("x-oNE"), "1");
    EXPECT_EQ(headers.value("x-two"), std::nullopt);
}

}  // namespace
}  // namespace ktr::platform
