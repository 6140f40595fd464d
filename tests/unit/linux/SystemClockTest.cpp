#include "linux/device/SystemClock.h"

#include <gtest/gtest.h>

#include <ctime>

namespace ktr::linux_ {

TEST(SystemClockTest, Now_CountsFromTheReferenceDate) {
    const auto before = static_cast<double>(std::time(nullptr));
    const double now = SystemClock().now().secondsSinceReferenceDate + platform::kSecondsFrom1970ToReferenceDate;
    EXPECT_GE(now, before);
    EXPECT_LE(now, before + 60.0);
}

}  // namespace ktr::linux_
