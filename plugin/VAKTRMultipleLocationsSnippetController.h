#pragma once

#include <memory>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "plugin/VAKTRBaseSnippetController.h"
#include "views/KTRVelaFriendView.h"
#include "views/KTRVelaSingleLabelView.h"

namespace ktr {

/// Several friends near a place: a row for each friend whose location is known, and a row that opens the whole list
/// when the service sent only part of it; a message as long as no location is known. Main thread.
class VAKTRMultipleLocationsSnippetController : public VAKTRBaseSnippetController {
  public:
    /// Rows by friend handle. Records without a handle have keys of their own that no handle has.
    using FriendViews = std::unordered_map<std::string, std::shared_ptr<KTRVelaFriendView>>;

    bool initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet) override;
    void loadView() override;
    void reloadData() override;
    /// The sum of the rows' heights; 90 when that is 0, such as while friends are being located.
    double desiredHeightForWidth(double width) override;
    /// As long as no location is known and refreshing goes on. It ends with the refreshing; the message follows at the
    /// next reload.
    bool isSearching() const override;

    /// Brings the rows in line with the locations. A row is found again by its friend's handle.
    virtual void createFriendViews();
    /// No location is known.
    bool showLocatingFriends() const;
    Locations proximityLocationsWithCoordinates() const;

    /// The service returned only part of the friends.
    bool displayShowAllRow() const { return displayShowAllRow_; }
    void setDisplayShowAllRow(bool display) { displayShowAllRow_ = display; }
    const FriendViews& friendViews() const { return friendViews_; }
    void setFriendViews(FriendViews views) {
        friendViews_ = std::move(views);
        arranged_.clear();
    }
    /// The message, and the row that opens the whole list.
    std::shared_ptr<KTRVelaSingleLabelView> singleLabelView() const { return singleLabelView_; }
    void setSingleLabelView(std::shared_ptr<KTRVelaSingleLabelView> view) { singleLabelView_ = std::move(view); }

  private:
    using Views = std::vector<std::shared_ptr<platform::View>>;
    using ArrangedRows = std::vector<std::pair<std::string, std::shared_ptr<KTRVelaFriendView>>>;

    std::shared_ptr<KTRVelaFriendView> makeFriendView();
    /// Fills the rows that are there, when the friends are those of the earlier pass in the same order; false when they
    /// are not, with nothing done.
    bool refillSameRows(const Locations& known);
    /// The row of the earlier pass, or a new one.
    std::shared_ptr<KTRVelaFriendView> rowForKey(const std::string& key);
    void showMessage();
    /// Puts the rows, and a wanted label after them, into the container in one step: a row at a time would cost the
    /// square of their number.
    void arrange(Views rows, const FriendViews& earlier);

    bool displayShowAllRow_ = false;
    FriendViews friendViews_;
    /// The rows as they were last arranged, each with its friend's key.
    ArrangedRows arranged_;
    std::shared_ptr<KTRVelaSingleLabelView> singleLabelView_;
};

}  // namespace ktr
