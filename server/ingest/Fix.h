#pragma once

#include <cstdint>
#include <optional>

namespace ktr::server {

/// Where somebody was, and when: all that is kept of what phones tell. A value.
struct Fix {
    std::int64_t time = 0;   ///< when they were there: seconds since 1970
    std::int64_t heard = 0;  ///< when the service learned of it: a phone without a network tells later
    double latitude = 0.0;   ///< degrees
    double longitude = 0.0;
    std::optional<double> accuracy;  ///< metres; none when nobody said

    bool operator==(const Fix&) const = default;
};

}  // namespace ktr::server
