#include "platform/map/MapPictureSource.h"

#include "platform/map/MapsApplication.h"

namespace ktr::platform {

MapPictureSource::~MapPictureSource() = default;
MapsApplication::~MapsApplication() = default;

}  // namespace ktr::platform
