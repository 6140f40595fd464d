#pragma once

#include <memory>

#include "platform/map/PlatformMapView.h"

namespace ktr {

/// Chooses how the plugin's maps draw their pin and its circle; one for all of them. Main thread.
class KTRVAMapDelegate : public platform::PlatformMapViewDelegate {
  public:
    /// Of fence pins and friend pins alike: a view that was made for one may be handed to the other, and keeps its
    /// look.
    static constexpr const char* kReuseIdentifier = "KTRVAMapDelegate";

    /// Kept for as long as the platform is installed; none without one.
    static std::shared_ptr<KTRVAMapDelegate> sharedInstance();
    static std::shared_ptr<KTRVAMapDelegate> makeShared() { return std::make_shared<KTRVAMapDelegate>(); }

    /// None for what is no pin of the plugin, such as the user. A view that the map has free gets the annotation and
    /// nothing else.
    std::shared_ptr<platform::AnnotationView> viewForAnnotation(
        platform::PlatformMapView& map, const std::shared_ptr<platform::MapAnnotation>& annotation) override;
    /// Every overlay of the plugin is a circle, filled in translucent orange; none for another.
    std::shared_ptr<platform::MapOverlayRenderer> rendererForOverlay(
        platform::PlatformMapView& map, const std::shared_ptr<platform::MapOverlay>& overlay) override;
};

}  // namespace ktr
