#pragma once

#include "platform/base/Api.h"
#include "platform/ui/Color.h"
#include "platform/ui/Font.h"

namespace ktr::platform {

/// Posted when `isDark`, `isHighContrast` or `reducesMotion` have changed.
inline constexpr const char* kAppearanceChangedNotification = "ktrAppearanceChanged";

/// The assistant interface's own type faces and standard colours, and how it is shown at present. Main thread.
class KTR_API AssistantAppearance {
  public:
    virtual ~AssistantAppearance();
    /// Sizes in points.
    virtual Font lightFont(double size) const = 0;
    virtual Font thinFont(double size) const = 0;
    virtual Color standardTextColor() const = 0;
    virtual Color highlightColor() const = 0;
    virtual bool isDark() const = 0;
    virtual bool isHighContrast() const = 0;
    /// The user wants things to be at their new places at once.
    virtual bool reducesMotion() const = 0;
};

}  // namespace ktr::platform
