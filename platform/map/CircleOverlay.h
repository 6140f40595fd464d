#pragma once

#include <memory>
#include <optional>

#include "platform/base/Object.h"
#include "platform/location/PlatformLocation.h"
#include "platform/map/MapViewport.h"
#include "platform/ui/Color.h"

namespace ktr::platform {

class Canvas;

/// Something that covers a part of the ground. Main thread.
class KTR_API MapOverlay : public Object {
  public:
    ~MapOverlay() override;
    /// In the datum of the map.
    virtual Coordinate coordinate() const = 0;
};

/// Everywhere within a distance of a place. Immutable.
class KTR_API CircleOverlay : public MapOverlay {
  public:
    /// Metres. A circle whose radius is not greater than 0 covers nothing.
    CircleOverlay(const Coordinate& center, double radius) : center_(center), radius_(radius) {}
    Coordinate coordinate() const override { return center_; }
    double radius() const { return radius_; }

  private:
    Coordinate center_;
    double radius_;
};

/// Where a position may be, as the service's client library has it.
class KTR_API KTAccuracyOverlay : public CircleOverlay {
  public:
    using CircleOverlay::CircleOverlay;
};

/// Draws an overlay. Main thread.
class KTR_API MapOverlayRenderer : public Object {
  public:
    explicit MapOverlayRenderer(std::shared_ptr<MapOverlay> overlay) : overlay_(std::move(overlay)) {}
    const std::shared_ptr<MapOverlay>& overlay() const { return overlay_; }
    /// From 0 to 1, of everything that is drawn.
    double alpha() const { return alpha_; }
    void setAlpha(double alpha) { alpha_ = alpha; }
    /// On a canvas whose origin is the viewport's.
    virtual void draw(Canvas& canvas, const MapViewport& viewport) const = 0;

  private:
    std::shared_ptr<MapOverlay> overlay_;
    double alpha_ = 1.0;
};

/// Draws a circle. Neither filled nor stroked until a colour is set.
class KTR_API CircleOverlayRenderer : public MapOverlayRenderer {
  public:
    explicit CircleOverlayRenderer(std::shared_ptr<CircleOverlay> circle)
        : MapOverlayRenderer(circle), circle_(std::move(circle)) {}
    const std::optional<Color>& fillColor() const { return fillColor_; }
    void setFillColor(std::optional<Color> color) { fillColor_ = color; }
    const std::optional<Color>& strokeColor() const { return strokeColor_; }
    void setStrokeColor(std::optional<Color> color) { strokeColor_ = color; }
    double lineWidth() const { return lineWidth_; }
    void setLineWidth(double points) { lineWidth_ = points; }
    /// Where the circle is drawn: the rectangle around the four places that lie its radius to the north, east, south
    /// and west. Empty when nothing is drawn.
    static Rect rectFor(const Coordinate& center, double radius, const MapViewport& viewport);
    void draw(Canvas& canvas, const MapViewport& viewport) const override;

  private:
    std::shared_ptr<CircleOverlay> circle_;
    std::optional<Color> fillColor_;
    std::optional<Color> strokeColor_;
    double lineWidth_ = 1.0;
};

}  // namespace ktr::platform
