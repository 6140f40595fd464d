#pragma once

#include "platform/ui/Appearance.h"

namespace ktr::linux_ {

/// The assistant interface's faces and colours. Colours are roles: what they look like is decided when they are
/// painted, so that light, dark and high contrast change without a rebuild. Where no light or thin face is installed,
/// Regular is shown. Main thread.
class QtAppearance final : public platform::AssistantAppearance {
  public:
    platform::Font lightFont(double size) const override;
    platform::Font thinFont(double size) const override;
    platform::Color standardTextColor() const override;
    platform::Color highlightColor() const override;
};

}  // namespace ktr::linux_
