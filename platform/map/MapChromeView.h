#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/map/MapViewport.h"
#include "platform/ui/View.h"

namespace ktr::platform {

class TextLayout;

/// What a map says in its corners, over everything else: how large it is drawn, and whose data it is; or that there is
/// no map. The corners follow the interface's direction. Main thread.
class MapChromeView : public View {
  public:
    bool initWithFrame(const Rect& frame) override;
    /// A map with a source of pictures has a scale, and the words of its data's owner if they are not empty; one
    /// without says so.
    void show(const MapViewport& viewport, bool hasSource, const std::string& attribution);
    /// What the corners should not cover: whoever stands there has the lower corner, and its words the upper one.
    void avoid(const std::vector<Rect>& rects, const Size& size);
    /// Where no label may stand, on a map of this size: room for any scale bar, and for usual attributions too before
    /// one is known, so that a picture need not be drawn twice.
    std::vector<Rect> clearRects(const Size& size) const;

  protected:
    void draw(Canvas& canvas) const override;

  private:
    void drawScale(Canvas& canvas) const;
    void drawAttribution(Canvas& canvas) const;
    void drawNote(Canvas& canvas) const;
    Rect scaleRoom(const Size& size, bool isAbove) const;
    Rect pillRoom(const Size& size, bool isAbove) const;
    Rect pillRect(const Size& size) const;
    /// The rectangle on the other side when the interface is read from right to left.
    Rect placed(const Rect& rect, double width) const;

    MapViewport viewport_;
    bool hasSource_ = false;
    bool isScaleAbove_ = false;
    bool isPillAbove_ = false;
    std::string attribution_;
    std::shared_ptr<const TextLayout> attributionLayout_;
    /// The width that the attribution was laid out for.
    double attributionWidth_ = 0.0;
};

}  // namespace ktr::platform
