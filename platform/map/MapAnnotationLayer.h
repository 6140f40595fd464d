#pragma once

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "platform/map/AnnotationView.h"
#include "platform/map/MapViewport.h"
#include "platform/ui/Animation.h"

namespace ktr::platform {

class PlatformMapView;

/// The views of one map's annotations: makes them, has them glide, and keeps those that are free. Main thread.
class MapAnnotationLayer {
  public:
    /// The map owns the layer.
    explicit MapAnnotationLayer(PlatformMapView& map) : map_(map) {}

    /// Makes the views fit the annotations; the map's delegate is asked for new ones. In this order, the last in front.
    void reconcile(const std::vector<std::shared_ptr<MapAnnotation>>& annotations);
    /// Puts every view where its annotation is at the moment.
    void place(const MapViewport& viewport);
    /// The rectangles that views with something to show will cover in this viewport once they have come to rest.
    std::vector<Rect> coveredRects(const MapViewport& viewport) const;
    std::shared_ptr<AnnotationView> viewFor(const MapAnnotation& annotation) const;
    std::shared_ptr<AnnotationView> dequeue(const std::string& reuseIdentifier);

  private:
    struct Placed {
        std::shared_ptr<MapAnnotation> annotation;
        std::shared_ptr<AnnotationView> view;
        std::shared_ptr<void> observation;
        /// Where it is shown at the moment; it may be on its way.
        Coordinate shown;
        std::shared_ptr<Animation> glide;
    };

    Placed* find(const MapAnnotation& annotation);
    void add(const std::shared_ptr<MapAnnotation>& annotation);
    void moved(Placed& placed);
    void place(Placed& placed, const MapViewport& viewport);

    PlatformMapView& map_;
    std::vector<Placed> placed_;
    std::unordered_map<std::string, std::vector<std::shared_ptr<AnnotationView>>> free_;
};

}  // namespace ktr::platform
