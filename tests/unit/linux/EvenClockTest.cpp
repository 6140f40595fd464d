#include "linux/device/EvenClock.h"

#include <gtest/gtest.h>

#include "platform/base/VirtualTime.h"

namespace ktr::test {

TEST(EvenClockTest, LeapOfTheOther_LeavesAgesAsTheyAre) {
    const auto other = std::make_shared<platform::VirtualTime>(platform::Date{1000.0});
    const linux_::EvenClock even(other);
    const auto moment = even.now();
    EXPECT_NEAR(moment.secondsSinceReferenceDate, 1000.0, 60.0);
    // The network tells the time: it is thirty days later.
    other->advance(30.0 * 86400.0);
    EXPECT_LT(even.now().secondsSinceReferenceDate - moment.secondsSinceReferenceDate, 60.0);
    EXPECT_NEAR(even.onTheOther(moment).secondsSinceReferenceDate, 1000.0 + 30.0 * 86400.0, 60.0)
        << "a clock face is of the time that is right now";
}

}  // namespace ktr::test
