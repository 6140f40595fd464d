#pragma once

#include <string>

#include "platform/location/PlatformLocation.h"

namespace ktr::platform {

/// A place with a name, without an address.
struct MapItem {
    Coordinate coordinate;
    std::string name;  ///< may be empty
};

/// The user's own application for maps. Main thread.
class KTR_API MapsApplication {
  public:
    virtual ~MapsApplication();
    /// Has the application show the place. False when there is none that does, and for an invalid coordinate.
    virtual bool open(const MapItem& item) = 0;
};

}  // namespace ktr::platform
