#pragma once

#include <optional>
#include <vector>

#include "platform/ui/View.h"

namespace ktr::platform {

/// What stands in a map's place where there is no place to show: plain ground, somebody in a broken circle, and two
/// words. A map of the world, or of the wrong place, would be an answer to another question. Main thread.
class MapPlacelessView : public View {
  public:
    bool initWithFrame(const Rect& frame) override;
    /// Where the circle and the words go: the words alone where there is no room for both, and nothing where there is
    /// none for them. All of the view at first. Words keep clear of what else stands over it.
    void setFree(const Rect& free, const std::vector<Rect>& taken);

  protected:
    void draw(Canvas& canvas) const override;

  private:
    std::optional<Rect> free_;
    std::vector<Rect> taken_;
};

}  // namespace ktr::platform
