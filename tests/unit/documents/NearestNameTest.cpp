#include "documents/NearestName.h"

#include <gtest/gtest.h>

namespace ktr::test {

using documents::didYouMean;
using documents::nearestName;

TEST(NearestNameTest, FewSlips_FindTheName) {
    const std::vector<std::string> names{"latitude", "longitude", "label", "city"};
    EXPECT_EQ(nearestName("lattitude", names), "latitude");
    EXPECT_EQ(nearestName("longtiude", names), "longitude");
    EXPECT_EQ(nearestName("LABEL", names), "label");
    EXPECT_EQ(nearestName("ciyt", names), "city");
    EXPECT_EQ(nearestName("labels", names), "label");
    EXPECT_EQ(didYouMean("lable", names), "; did you mean \"label\"?");
}

TEST(NearestNameTest, AnotherWord_FindsNone) {
    const std::vector<std::string> names{"latitude", "at"};
    EXPECT_EQ(nearestName("attribution", names), std::nullopt);
    EXPECT_EQ(nearestName("", names), std::nullopt);
    EXPECT_EQ(nearestName("xy", names), std::nullopt);
    EXPECT_EQ(nearestName(std::string(1'000'000, 'a'), names), std::nullopt);
    EXPECT_EQ(didYouMean("street", names), "");
}

}  // namespace ktr::test
