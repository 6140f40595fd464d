#pragma once

#include <memory>
#include <string>

#include "linux/maps/MapGround.h"
#include "platform/location/PlatformLocation.h"

namespace ktr::bench {

/// An MBTiles file of pictures, drawn from another ground: what a file of pictures costs can then be held beside what
/// the same map costs from vectors.
class PictureMap {
  public:
    /// Writes PNG tiles of 256 pixels for some kilometres around a place, levels 12 to 17. False when the file cannot
    /// be written.
    static bool write(const std::string& path, const std::shared_ptr<linux_::MapGround>& ground,
                      const platform::Coordinate& centre);
};

}  // namespace ktr::bench
