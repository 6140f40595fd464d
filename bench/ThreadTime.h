#pragma once

#include <time.h>

#include <functional>

namespace ktr::bench {

/// Milliseconds that this thread has computed; what else the machine does is no part of it.
inline double computed() {
    timespec now{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &now);
    return 1e3 * static_cast<double>(now.tv_sec) + 1e-6 * static_cast<double>(now.tv_nsec);
}

/// What the work computes, milliseconds.
inline double timed(const std::function<void()>& work) {
    const double start = computed();
    work();
    return computed() - start;
}

}  // namespace ktr::bench
