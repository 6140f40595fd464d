#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "platform/base/Geometry.h"
#include "platform/base/Object.h"

namespace ktr::platform {

/// A picture that a Canvas of the same host can draw, at any scale. Immutable.
class KTR_API Image : public Object {
  public:
    /// Points.
    virtual Size size() const = 0;
};

using Bytes = std::vector<std::uint8_t>;

/// Named images of bundles, and images from data. Main thread; answers from memory.
class KTR_API ImageSource {
  public:
    virtual ~ImageSource();
    /// The variant of the named image that fits the device (scale, idiom, light or dark), or none.
    virtual std::shared_ptr<Image> imageNamed(const std::string& name, const std::string& bundleIdentifier) = 0;
    /// None when the data is no picture that can be read, or one beyond the size cap.
    virtual std::shared_ptr<Image> imageFromData(const Bytes& data) = 0;
};

}  // namespace ktr::platform
