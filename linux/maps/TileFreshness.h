#pragma once

#include <cstdint>
#include <string>

namespace ktr::linux_ {

/// How long an answer may be used again (RFC 9111, section 4.2), for a cache of one user. A value.
struct TileFreshness {
    std::int64_t expires = 0;  ///< seconds since 1970
    bool isStored = true;      ///< whether it may be kept on disk

    /// The fields as the server sent them, empty for missing ones; `now` in seconds since 1970. Without a word about it
    /// a tile is fresh for a day; never for longer than a year.
    static TileFreshness of(const std::string& cacheControl, const std::string& age, const std::string& expires,
                            std::int64_t now);
};

}  // namespace ktr::linux_
