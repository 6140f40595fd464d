#pragma once

#include <memory>

#include "platform/assistant/VAKtrGeoFence.h"
#include "plugin/VAKTRBaseSnippetController.h"
#include "views/KTRDynVelaMapView.h"
#include "views/KTRVelaFenceView.h"

namespace ktr {

/// A fence that was set up or reported: a row that says whom and which place it concerns, above a map of the place. The
/// fence does not change, so nothing is redrawn later. Main thread.
class VAKTRGeoFenceSnippetController : public VAKTRBaseSnippetController {
  public:
    bool initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) override;
    void loadView() override;
    /// The row and the map. Does not load the view, unlike the other controllers: a row that is not there counts 0.
    double desiredHeightForWidth(double width) override;

    /// The snippet's, as it stands; may be none.
    std::shared_ptr<platform::VAKtrGeoFence> cueKtrGeoFence() const { return cueKtrGeoFence_; }
    void setCueKtrGeoFence(std::shared_ptr<platform::VAKtrGeoFence> fence) { cueKtrGeoFence_ = std::move(fence); }
    /// The map's, degrees; 0 without a context.
    double zoomLevel() const { return zoomLevel_; }
    void setZoomLevel(double zoomLevel) { zoomLevel_ = zoomLevel; }
    std::shared_ptr<KTRVelaFenceView> fenceView() const { return fenceView_; }
    void setFenceView(std::shared_ptr<KTRVelaFenceView> view) { fenceView_ = std::move(view); }
    std::shared_ptr<KTRDynVelaMapView> mapView() const { return mapView_; }
    void setMapView(std::shared_ptr<KTRDynVelaMapView> view) { mapView_ = std::move(view); }

  private:
    std::shared_ptr<platform::VAKtrGeoFence> cueKtrGeoFence_;
    double zoomLevel_ = 0.0;
    std::shared_ptr<KTRVelaFenceView> fenceView_;
    std::shared_ptr<KTRDynVelaMapView> mapView_;
};

}  // namespace ktr
