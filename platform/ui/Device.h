#pragma once

#include <optional>

#include "platform/base/Api.h"
#include "platform/ui/Font.h"

namespace ktr::platform {

enum class UserInterfaceIdiom { Phone, Tablet, Desktop, Display };

/// The device that shows the answers. Main thread; answers from memory.
class KTR_API Device {
  public:
    virtual ~Device();
    /// None when the device does not know.
    virtual std::optional<UserInterfaceIdiom> userInterfaceIdiom() const = 0;
    /// Pixels a point of the main screen; greater than 0.
    virtual double mainScreenScale() const = 0;
    virtual ContentSizeCategory contentSizeCategory() const = 0;
};

}  // namespace ktr::platform
