#pragma once

#include "platform/ui/View.h"

namespace ktr::host {

/// Shows its subviews with a given opacity. Main thread.
class FadeView : public platform::View {
  public:
    /// From 0 to 1.
    double opacity() const { return opacity_; }
    void setOpacity(double opacity);

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    double opacity_ = 1.0;
};

}  // namespace ktr::host
