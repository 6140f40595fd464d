#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "model/KTRVAMyLocation.h"
#include "plugin/VAKTRBaseSnippetController.h"
#include "views/KTRDynVelaMapView.h"
#include "views/KTRVelaFriendView.h"

namespace ktr {

/// Whether friends can see the user: the user's own row and, as long as they can, a map of the user's place, which the
/// refresh controller then keeps telling the service. Main thread.
class VAKTRVisibilityController : public VAKTRBaseSnippetController {
  public:
    bool initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) override;
    /// Has the refresh controller show the user's place instead of asking for friends; a hidden user's goes on asking.
    void setDelegate(const std::shared_ptr<platform::SnippetHostDelegate>& delegate) override;
    void loadView() override;
    void reloadData() override;
    /// A visible user's record is the last thing of the command's result, or none. The base then takes the whole list
    /// as if it were friends; nothing here reads what it makes of it.
    void locationsUpdated(const std::shared_ptr<const ServiceResult>& result) override;
    /// Redraws. Reads `refreshingCancelled` and, unlike the base, leaves it as it is.
    void refreshCancelled() override;
    /// The user; nobody as long as the record holds no person.
    std::vector<std::shared_ptr<platform::VAPerson>> friends() const override;
    /// Always none.
    std::optional<std::string> proximity() const override { return std::nullopt; }
    /// The row and, when there is one, the map; loads the view if there is none.
    double desiredHeightForWidth(double width) override;

    /// As long as a shared place is not known and refreshing goes on; ends with the refreshing, though the row says on
    /// that it is being located.
    bool isSearching() const override;

    /// The user's place is shared, as the snippet said.
    bool isVisible() const { return isVisible_; }
    void setIsVisible(bool visible) { isVisible_ = visible; }
    /// Kept for whoever asks; this controller neither sets nor reads it.
    bool disableSelection() const { return disableSelection_; }
    void setDisableSelection(bool disable) { disableSelection_ = disable; }
    /// What the row shows; may be none.
    std::shared_ptr<KTRVAMyLocation> myLocation() const { return myLocation_; }
    void setMyLocation(std::shared_ptr<KTRVAMyLocation> location) { myLocation_ = std::move(location); }
    std::shared_ptr<KTRVelaFriendView> friendView() const { return friendView_; }
    void setFriendView(std::shared_ptr<KTRVelaFriendView> view) { friendView_ = std::move(view); }
    /// None for a hidden user.
    std::shared_ptr<KTRDynVelaMapView> mapView() const { return mapView_; }
    void setMapView(std::shared_ptr<KTRDynVelaMapView> view) { mapView_ = std::move(view); }

  private:
    void showMyLocation();

    bool isVisible_ = false;
    bool disableSelection_ = false;
    std::shared_ptr<KTRVAMyLocation> myLocation_;
    std::shared_ptr<KTRVelaFriendView> friendView_;
    std::shared_ptr<KTRDynVelaMapView> mapView_;
};

}  // namespace ktr
