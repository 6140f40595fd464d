#pragma once

#include "platform/base/Api.h"
#include "platform/base/Date.h"

namespace ktr::platform {

/// The present moment. Any thread.
class KTR_API Clock {
  public:
    virtual ~Clock();
    virtual Date now() const = 0;
};

/// Wall-clock arithmetic in the user's calendar and time zone. Main thread.
class KTR_API Calendar {
  public:
    struct TimeOfDay {
        int hour = 0;
        int minute = 0;
        int second = 0;
        bool operator==(const TimeOfDay&) const = default;
    };

    virtual ~Calendar();
    virtual TimeOfDay timeOfDay(Date date) const = 0;
    /// The date with the amounts added to its wall-clock time: across a daylight-saving change the clock face counts,
    /// not the seconds that passed. The fraction of a second is kept. A wall-clock time that does not exist moves
    /// forward.
    virtual Date adding(TimeOfDay amounts, Date date) const = 0;
};

}  // namespace ktr::platform
