#pragma once

#include <cstdio>
#include <cstdlib>

namespace ktr::fuzz {

/// What holds for every input. A fuzzer's build has no other way to fail than to end.
inline void require(bool holds, const char* what) {
    if (!holds) {
        std::fprintf(stderr, "does not hold: %s\n", what);
        std::abort();
    }
}

}  // namespace ktr::fuzz
