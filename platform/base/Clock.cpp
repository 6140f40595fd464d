#include "platform/base/Clock.h"

namespace ktr::platform {

Clock::~Clock() = default;
Calendar::~Calendar() = default;

}  // namespace ktr::platform
