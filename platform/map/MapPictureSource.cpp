#include "platform/map/MapPictureSource.h"

namespace ktr::platform {

MapPictureSource::~MapPictureSource() = default;

}  // namespace ktr::platform
