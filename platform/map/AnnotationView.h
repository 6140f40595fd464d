#pragma once

#include <memory>
#include <string>

#include "platform/map/MapAnnotation.h"
#include "platform/ui/View.h"

namespace ktr::platform {

/// Draws an annotation on a map. The map places it, keeps it in a queue by its identifier when its annotation has gone,
/// and hands it out again. Main thread.
class KTR_API AnnotationView : public View {
  public:
    /// False when the view cannot be made.
    virtual bool initWithAnnotation(const std::shared_ptr<MapAnnotation>& annotation,
                                    const std::string& reuseIdentifier);

    const std::shared_ptr<MapAnnotation>& annotation() const { return annotation_; }
    void setAnnotation(std::shared_ptr<MapAnnotation> annotation);
    const std::string& reuseIdentifier() const { return reuseIdentifier_; }

    /// What a tap on the view would do: nothing here, since no view shows a callout or is selected yet.
    bool canShowCallout() const { return canShowCallout_; }
    void setCanShowCallout(bool canShow) { canShowCallout_ = canShow; }
    bool enabled() const { return enabled_; }
    void setEnabled(bool enabled) { enabled_ = enabled; }

    /// Where the annotation's coordinate stands, in the view's own coordinates.
    Point anchorPoint() const { return anchorPoint_; }
    /// Makes the view as large as it has to be on a map of this size, its anchor point with it.
    virtual void prepareForMap(const Size& mapSize, double pointsPerMetre);
    /// The part of the view, in its own coordinates, under which no words of the map should stand.
    virtual Rect opaqueRect() const { return bounds(); }

  protected:
    /// Whether there is a known place to draw something at.
    bool drawsAnnotation() const { return annotation_ && annotation_->hasKnownLocation(); }
    /// Called when the view has been given another annotation.
    virtual void annotationChanged() {}
    void setExtent(const Size& size, Point anchor);

  private:
    std::shared_ptr<MapAnnotation> annotation_;
    std::string reuseIdentifier_;
    Point anchorPoint_;
    bool canShowCallout_ = true;
    bool enabled_ = true;
};

/// A drop that stands on a place, with an icon. Main thread.
class KTR_API MarkerAnnotationView : public AnnotationView {
  public:
    bool initWithAnnotation(const std::shared_ptr<MapAnnotation>& annotation,
                            const std::string& reuseIdentifier) override;
    const Color& markerTintColor() const { return markerTintColor_; }
    void setMarkerTintColor(const Color& color);

  protected:
    void draw(Canvas& canvas) const override;

  private:
    Color markerTintColor_ = Color::systemRed();
};

/// The user: a dot, and a halo as large as their position is sure. Main thread.
class KTR_API UserLocationView : public AnnotationView {
  public:
    void prepareForMap(const Size& mapSize, double pointsPerMetre) override;
    Rect opaqueRect() const override;

  protected:
    void draw(Canvas& canvas) const override;
};

}  // namespace ktr::platform
