#pragma once

#include <memory>

#include "plugin/VAKTRBaseSnippetController.h"
#include "views/KTRDynVelaMapView.h"
#include "views/KTRVelaFriendView.h"

namespace ktr {

/// Where one friend is: a row above a map. Both show the first location, whatever it holds. Main thread.
class VAKTRLocationSnippetController : public VAKTRBaseSnippetController {
  public:
    bool initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) override;
    void loadView() override;
    void reloadData() override;
    /// Shows the row as no longer refreshing. Reads `refreshingCancelled` and, unlike the base, leaves it as it is.
    void refreshCancelled() override;
    /// The row and the map; loads the view if there is none.
    double desiredHeightForWidth(double width) override;

    /// While the row says that the friend is being located.
    bool isSearching() const override;

    /// No record has a coordinate; so it is with no records.
    bool allEmptyLocations() const;
    /// The snippet asked about several friends, and no place is known. This controller's drawing does not ask.
    bool showLocatingFriends() const;
    Locations proximityLocationsWithCoordinates() const;

    /// The service returned only part of the friends. No row is drawn for it here.
    bool displayShowAllRow() const { return displayShowAllRow_; }
    void setDisplayShowAllRow(bool display) { displayShowAllRow_ = display; }
    /// The text size was an accessibility size when the view was loaded.
    bool axSize() const { return axSize_; }
    void setAxSize(bool axSize) { axSize_ = axSize; }
    /// The map's, degrees.
    double zoomLevel() const { return zoomLevel_; }
    void setZoomLevel(double zoomLevel) { zoomLevel_ = zoomLevel; }
    std::shared_ptr<KTRVelaFriendView> friendView() const { return friendView_; }
    void setFriendView(std::shared_ptr<KTRVelaFriendView> view) { friendView_ = std::move(view); }
    std::shared_ptr<KTRDynVelaMapView> mapView() const { return mapView_; }
    void setMapView(std::shared_ptr<KTRDynVelaMapView> view) { mapView_ = std::move(view); }

  private:
    void showLocation();

    bool displayShowAllRow_ = false;
    bool axSize_ = false;
    double zoomLevel_ = 0.0;
    std::shared_ptr<KTRVelaFriendView> friendView_;
    std::shared_ptr<KTRDynVelaMapView> mapView_;
};

}  // namespace ktr
