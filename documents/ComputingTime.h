#pragma once

#include <chrono>
#include <ctime>

namespace ktr::documents {

/// What this thread has computed so far: what a reader's budget is counted in, since a busy machine does not use it up.
/// Any thread.
inline std::chrono::nanoseconds computingTime() {
    timespec now{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
    return std::chrono::seconds(now.tv_sec) + std::chrono::nanoseconds(now.tv_nsec);
}

}  // namespace ktr::documents
