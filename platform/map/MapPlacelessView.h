#pragma once

#include "platform/ui/View.h"

namespace ktr::platform {

/// What stands in a map's place where there is no place to show: plain ground, somebody in a broken circle, and two
/// words. A map of the world, or of the wrong place, would be an answer to another question. Main thread.
class MapPlacelessView : public View {
  public:
    bool initWithFrame(const Rect& frame) override;

  protected:
    void draw(Canvas& canvas) const override;
};

}  // namespace ktr::platform
