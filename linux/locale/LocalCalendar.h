#pragma once

#include "platform/base/Clock.h"

namespace ktr::linux_ {

/// The C library's time zone (TZ, else the system's), followed when it changes. A wall-clock time that comes twice is
/// read with the offset of the date that the amounts were added to where that fits, else as the first of the two. A
/// date beyond what the C library knows is taken as UTC; one that is not finite stays as it is. Main thread.
class LocalCalendar : public platform::Calendar {
  public:
    TimeOfDay timeOfDay(platform::Date date) const override;
    platform::Date adding(TimeOfDay amounts, platform::Date date) const override;
};

}  // namespace ktr::linux_
