#include "documents/HttpTime.h"

#include <gtest/gtest.h>

namespace ktr::test {

using documents::parseHttpTime;

TEST(HttpTimeTest, TheOneFormThatMayBeSent_IsRead) {
    for (const char* text : {"Sun, 06 Nov 1994 08:49:37 GMT", " Sun, 06 Nov 1994 08:49:37 GMT\t"}) {
        const auto date = parseHttpTime(text);
        ASSERT_TRUE(date.has_value()) << text;
        EXPECT_EQ(date->secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate, 784111777.0);
    }
    EXPECT_EQ(parseHttpTime("Thu, 01 Jan 1970 00:00:00 GMT")->secondsSinceReferenceDate,
              -platform::kSecondsFrom1970ToReferenceDate);
    EXPECT_TRUE(parseHttpTime("Wed, 31 Dec 1969 23:59:59 GMT").has_value());
}

TEST(HttpTimeTest, AnythingElse_IsNone) {
    for (const char* text :
         {"", "0", "soon", "Sunday, 06-Nov-94 08:49:37 GMT", "Sun Nov  6 08:49:37 1994",
          "Mon, 06 Nov 1994 08:49:37 GMT", "Sun, 06 Nov 1994 08:49:37 UTC", "Sun, 6 Nov 1994 08:49:37 GMT",
          "Sun, 06 nov 1994 08:49:37 GMT", "Thu, 31 Feb 1994 08:49:37 GMT", "Sun, 06 Nov 1994 24:49:37 GMT",
          "Sun, 06 Nov 1994 08:49:60 GMT", "Sun, 06 Nov 1994 08:49.37 GMT",
          "Sun, 06 Nov 1994 08:49:37 GMT, and more"}) {
        EXPECT_EQ(parseHttpTime(text), std::nullopt) << text;
    }
}

TEST(HttpTimeTest, RetryAfter_IsSecondsOrAMoment) {
    using documents::parseRetryAfter;
    using std::chrono::seconds;
    const auto now = *parseHttpTime("Sun, 06 Nov 1994 08:49:37 GMT");
    EXPECT_EQ(parseRetryAfter("0", now), seconds(0));
    EXPECT_EQ(parseRetryAfter(" 120\t", now), seconds(120));
    EXPECT_EQ(parseRetryAfter("Sun, 06 Nov 1994 08:51:37 GMT", now), seconds(120));
    EXPECT_EQ(parseRetryAfter("Sun, 06 Nov 1994 08:00:00 GMT", now), seconds(0));
    EXPECT_EQ(parseRetryAfter("Fri, 31 Dec 9999 23:59:59 GMT", now), seconds(31536000));
    EXPECT_EQ(parseRetryAfter(std::string(10000, '9'), now), seconds(31536000));
    for (const char* text : {"", " ", "-1", "+1", "1.5", "soon", "1 2", "0x10"}) {
        EXPECT_EQ(parseRetryAfter(text, now), std::nullopt) << text;
    }
}

}  // namespace ktr::test
