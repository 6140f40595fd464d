#pragma once

#include "linux/paint/Palette.h"
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
    bool isDark() const override { return scheme_ == ColorScheme::Dark; }
    bool isHighContrast() const override { return contrast_ == Contrast::High; }
    bool reducesMotion() const override { return reducesMotion_; }

    /// What the host shows. Posts `kAppearanceChangedNotification` when something changes while a platform is
    /// installed.
    void show(ColorScheme scheme, Contrast contrast);
    void setReducesMotion(bool reduces);

  private:
    ColorScheme scheme_ = ColorScheme::Light;
    Contrast contrast_ = Contrast::Normal;
    bool reducesMotion_ = false;
};

}  // namespace ktr::linux_
