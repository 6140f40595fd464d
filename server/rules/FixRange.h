#pragma once

#include <cstdint>

#include "server/ingest/Fix.h"

namespace ktr::server {

/// Some of a person's fixes, by their times and by when they were heard; seconds since 1970. A value.
struct FixRange {
    std::int64_t from = 0;
    std::int64_t end = 0;  ///< before it
    std::int64_t heardFrom = 0;
    std::int64_t heardEnd = 0;  ///< before it

    bool holds(const Fix& fix) const {
        return fix.time >= from && fix.time < end && fix.heard >= heardFrom && fix.heard < heardEnd;
    }
};

enum class FixEdge { First, Last };

}  // namespace ktr::server
