#include "documents/IsoTime.h"

#include <gtest/gtest.h>

namespace ktr::documents {

namespace {

constexpr double kNoon = 790171200.0;  // 2026-01-15 12:00 UTC since the reference date

TEST(KTRIsoTimeTest, Utc_ReadsEveryForm) {
    for (const char* text : {"2026-01-15T12:00", "2026-01-15T12:00Z", "2026-01-15T12:00:00", "2026-01-15T12:00:00Z",
                             "2026-01-15T12:00:00.000Z", "2026-01-15T12:00:00+00:00"}) {
        const auto time = parseIsoTime(text);
        ASSERT_TRUE(time) << text;
        EXPECT_EQ(time->date.secondsSinceReferenceDate, kNoon) << text;
        EXPECT_EQ(time->offsetSeconds, 0) << text;
    }
}

TEST(KTRIsoTimeTest, Offset_IsTakenOffAndKept) {
    const auto east = parseIsoTime("2026-01-15T17:30:00+05:30");
    ASSERT_TRUE(east);
    EXPECT_EQ(east->date.secondsSinceReferenceDate, kNoon);
    EXPECT_EQ(east->offsetSeconds, 19800);
    const auto west = parseIsoTime("2026-01-15T04:00-08:00");
    ASSERT_TRUE(west);
    EXPECT_EQ(west->date.secondsSinceReferenceDate, kNoon);
    EXPECT_EQ(west->offsetSeconds, -28800);
}

TEST(KTRIsoTimeTest, Fraction_IsKept) {
    const auto time = parseIsoTime("2026-01-15T12:00:00.25Z");
    ASSERT_TRUE(time);
    EXPECT_DOUBLE_EQ(time->date.secondsSinceReferenceDate, kNoon + 0.25);
}

TEST(KTRIsoTimeTest, LeapDay_ExistsInLeapYearsOnly) {
    EXPECT_TRUE(parseIsoTime("2024-02-29T00:00"));
    EXPECT_FALSE(parseIsoTime("2026-02-29T00:00"));
}

TEST(KTRIsoTimeTest, AnythingElse_IsNone) {
    for (const char* text :
         {"", "2026", "2026-01-15", "2026-01-15 12:00", "2026-1-15T12:00", "2026-13-01T00:00", "2026-00-10T00:00",
          "2026-01-32T00:00", "2026-01-15T24:00", "2026-01-15T12:60", "2026-01-15T12:00:60", "2026-01-15T12:00:00.",
          "2026-01-15T12:00:00+5", "2026-01-15T12:00+24:00", "2026-01-15T12:00Zx", "yesterday", "-026-01-15T12:00"}) {
        EXPECT_FALSE(parseIsoTime(text)) << text;
    }
}

}  // namespace

}  // namespace ktr::documents
