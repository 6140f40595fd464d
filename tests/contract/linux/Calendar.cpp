#include "linux/locale/LocalCalendar.h"
#include "tests/contract/CalendarContract.h"
#include "tests/support/EnvironmentVariable.h"

namespace ktr::test {

namespace {

/// The C library's calendar, in UTC as long as it lives.
class UtcLocalCalendar : public linux_::LocalCalendar {
    EnvironmentVariable zone_{"TZ", "UTC0"};
};

}  // namespace

INSTANTIATE_TEST_SUITE_P(LocalCalendar, CalendarContract,
                         ::testing::Values(CalendarCase{"LocalCalendar",
                                                        [] { return std::make_shared<UtcLocalCalendar>(); }}),
                         [](const auto& tested) { return tested.param.name; });

}  // namespace ktr::test
