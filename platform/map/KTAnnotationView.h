#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/map/AnnotationView.h"
#include "platform/map/CircleOverlay.h"
#include "platform/ui/Image.h"

namespace ktr::platform {

/// What the service's client library draws of somebody or something on a map. Main thread.
class KTR_API KTAnnotation : public MapAnnotation {
  public:
    /// A border around the large icon.
    virtual bool isBorderEnabled() const = 0;
    virtual std::shared_ptr<Image> largeAnnotationIcon() const = 0;
    /// Stands in for the large icon where there is none.
    virtual std::shared_ptr<Image> smallAnnotationIcon() const = 0;
    /// Over the icon's lower end; in place of the large one the small one, or neither.
    virtual std::shared_ptr<Image> largeOverlayIcon() const = 0;
    virtual std::shared_ptr<Image> smallOverlayIcon() const = 0;
    /// None: the view's own.
    virtual std::optional<Color> tintColor() const = 0;
    /// Metres.
    virtual double distanceFromUser() const = 0;
    virtual double horizontalAccuracy() const = 0;
    virtual std::shared_ptr<KTAccuracyOverlay> overlay() const = 0;
    /// The device that shows the map: its pin would hide the user's dot, so nothing is drawn.
    virtual bool isThisDevice() const = 0;
};

/// The client library's pin: an icon in a ring of the tint, with a tip on the place. Main thread.
class KTR_API KTAnnotationView : public AnnotationView {
  public:
    using AnnotationView::initWithAnnotation;
    virtual bool initWithAnnotation(const std::shared_ptr<MapAnnotation>& annotation,
                                    const std::string& reuseIdentifier, const Color& tintColor);

    // Settings of all pins of the installed platform
    /// A border around every large icon, whatever its annotation says. On unless turned off.
    static bool isLargeAnnotationBorderVisible();
    static void setLargeAnnotationBorderVisible(bool visible);
    /// Icons are cut to the circle that they stand in. Off unless turned on.
    static bool isLayerMaskingEnabled();
    static void setLayerMaskingEnabled(bool enabled);

    const Color& tintColor() const { return tintColor_; }
    /// Large on a map that is at least 300 points high.
    void prepareForMap(const Size& mapSize, double pointsPerMetre) override;

  protected:
    void draw(Canvas& canvas) const override;
    void annotationChanged() override { layOutPin(); }

  private:
    struct Measures;
    Measures measures() const;
    void layOutPin();
    void drawIcon(Canvas& canvas, const KTAnnotation& annotation, const Rect& disc) const;

    Color tintColor_;
    bool isLarge_ = false;
};

}  // namespace ktr::platform
