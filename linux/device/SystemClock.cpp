#include "linux/device/SystemClock.h"

#include <chrono>

namespace ktr::linux_ {

platform::Date SystemClock::now() const {
    const std::chrono::duration<double> since1970 = std::chrono::system_clock::now().time_since_epoch();
    return {since1970.count() - platform::kSecondsFrom1970ToReferenceDate};
}

}  // namespace ktr::linux_
