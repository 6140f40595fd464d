#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/assistant/VAKtrGeoFence.h"
#include "platform/layout/LayoutConstraint.h"
#include "platform/ui/ImageView.h"
#include "views/CurrentLocationDelegate.h"
#include "views/KTRVelaBaseView.h"

namespace ktr {

/// One fence: the friend's avatar on the leading side; beside it the friend's name with a small icon at the trailing
/// edge, and a sentence that says when the user will hear of the friend; a hairline at the bottom. A tap opens the
/// friend. With an accessibility text size the row has no subviews and its labels are none. Unlike a friend's row it
/// listens to no position: nothing in it depends on where the user is. Main thread.
class KTRVelaFenceView : public KTRVelaBaseView {
  public:
    bool initWithFrame(const platform::Rect& frame) override;
    /// Builds the subviews and their constraints.
    virtual void setupView();
    /// Fills the row from its fence; none reads as one that tells of nobody's arrival anywhere. The avatar follows 0.1
    /// seconds later.
    virtual void updateFenceView();
    /// Hides each text that is "", shows the other ones.
    void updateViewVisibility();

    /// The person's full name, else the handle as it stands; none when there is neither.
    std::optional<std::string> friendName() const;
    /// The last of the person's e-mail addresses, or of their numbers.
    std::optional<std::string> friendEmail() const;
    std::optional<std::string> friendPhone() const;
    /// The e-mail address, else the number.
    std::optional<std::string> friendHandle() const;

    /// "wayloc://friend/" and the handle by which the service knows the friend, nothing escaped; none without one.
    std::optional<platform::Url> urlForTouch() override;
    /// The least height that the row's constraints allow at its present width, points.
    double estimagedHeightForView() override;
    /// A link as long as there is a friend to open; else a text.
    platform::AccessibilityRole accessibilityRole() const override;
    /// The whole row in one line that begins with the person; the same at every text size.
    std::string accessibilityText() const override;

    /// Kept for subclasses; this row does not ask for the user's position.
    std::shared_ptr<CurrentLocationDelegate> currentLocationDelegate() const { return currentLocationDelegate_.lock(); }
    void setCurrentLocationDelegate(std::weak_ptr<CurrentLocationDelegate> delegate) {
        currentLocationDelegate_ = std::move(delegate);
    }
    std::shared_ptr<platform::VAKtrGeoFence> geoFence() const { return geoFence_; }
    /// Always fills the row anew, also for the fence that it has.
    virtual void setGeoFence(std::shared_ptr<platform::VAKtrGeoFence> geoFence);
    /// True from the start; nothing reads it.
    bool isRefreshingLocation() const { return isRefreshingLocation_; }
    void setIsRefreshingLocation(bool isRefreshing) { isRefreshingLocation_ = isRefreshing; }

    std::shared_ptr<platform::Label> nameLabel() const { return nameLabel_; }
    void setNameLabel(std::shared_ptr<platform::Label> label) { nameLabel_ = std::move(label); }
    std::shared_ptr<platform::Label> fenceLabel() const { return fenceLabel_; }
    void setFenceLabel(std::shared_ptr<platform::Label> label) { fenceLabel_ = std::move(label); }
    /// Never made by this row: a fence has no distance. Whoever sets one has it shown and hidden with its text.
    std::shared_ptr<platform::Label> distanceLabel() const { return distanceLabel_; }
    void setDistanceLabel(std::shared_ptr<platform::Label> label) { distanceLabel_ = std::move(label); }
    std::shared_ptr<platform::ImageView> geoFenceIconImageView() const { return geoFenceIconImageView_; }
    void setGeoFenceIconImageView(std::shared_ptr<platform::ImageView> view) {
        geoFenceIconImageView_ = std::move(view);
    }
    /// Both kept for subclasses; this row neither sets nor consults them.
    std::shared_ptr<platform::LayoutConstraint> nameLabelLeadingConstraint() const {
        return nameLabelLeadingConstraint_;
    }
    void setNameLabelLeadingConstraint(std::shared_ptr<platform::LayoutConstraint> constraint) {
        nameLabelLeadingConstraint_ = std::move(constraint);
    }
    bool constraintSetupCompleted() const { return constraintSetupCompleted_; }
    void setConstraintSetupCompleted(bool completed) { constraintSetupCompleted_ = completed; }

  protected:
    /// Makes the location indicator and adds it to the row.
    void setupIcon();
    /// Looks the friend's contact up and hands it to the avatar 0.1 seconds later.
    void updateAvatar();
    /// When the user will hear of the friend.
    std::string fenceSentence() const;

  private:
    void setupLabels();
    void setupConstraints();
    std::shared_ptr<platform::VAPerson> person() const;
    /// The handle by which the service knows the friend, or none.
    std::optional<std::string> serviceHandle() const;

    std::weak_ptr<CurrentLocationDelegate> currentLocationDelegate_;
    std::shared_ptr<platform::VAKtrGeoFence> geoFence_;
    bool isRefreshingLocation_ = false;
    std::shared_ptr<platform::Label> nameLabel_;
    std::shared_ptr<platform::Label> fenceLabel_;
    std::shared_ptr<platform::Label> distanceLabel_;
    std::shared_ptr<platform::ImageView> geoFenceIconImageView_;
    std::shared_ptr<platform::LayoutConstraint> nameLabelLeadingConstraint_;
    bool constraintSetupCompleted_ = false;
};

}  // namespace ktr
