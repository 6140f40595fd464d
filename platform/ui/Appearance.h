#pragma once

#include "platform/base/Api.h"
#include "platform/ui/Color.h"
#include "platform/ui/Font.h"

namespace ktr::platform {

/// The assistant interface's own type faces and standard colours. Main thread.
class KTR_API AssistantAppearance {
  public:
    virtual ~AssistantAppearance();
    /// Sizes in points.
    virtual Font lightFont(double size) const = 0;
    virtual Font thinFont(double size) const = 0;
    virtual Color standardTextColor() const = 0;
    virtual Color highlightColor() const = 0;
};

}  // namespace ktr::platform
