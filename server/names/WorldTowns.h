#pragma once

#include <span>

namespace ktr::server {

/// The larger towns of the built-in world: made at build time from resources/maps/world.bin. Any thread.
class WorldTowns {
  public:
    struct Town {
        double latitude;  ///< degrees
        double longitude;
        const char* name;  ///< in English
        const char* zone;  ///< the time zone that bears its name; may be empty
    };
    static std::span<const Town> all();
};

}  // namespace ktr::server
