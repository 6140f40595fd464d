#pragma once

#include <memory>
#include <optional>
#include <string>

#include "model/KTRVALocation.h"
#include "model/KTRVAUIUtils.h"
#include "platform/base/NotificationCenter.h"
#include "platform/ui/AccessibilitySubject.h"
#include "views/CurrentLocationDelegate.h"
#include "views/KTRVelaBaseView.h"

namespace ktr {

/// One friend: the avatar on the leading side; beside it the place, the name with the distance, and the age of the fix;
/// a hairline at the bottom. A tap opens the friend. With an accessibility text size the row has no subviews, its
/// labels are none and texts set on them go nowhere. Main thread.
class KTRVelaFriendView : public KTRVelaBaseView, public platform::AccessibilitySubjectView {
  public:
    bool initWithFrame(const platform::Rect& frame) override;
    /// Builds the subviews and their constraints.
    virtual void setupView();
    /// Fills the row from its record; every missing piece becomes an empty text. The avatar follows 0.1 seconds later.
    virtual void updateView();

    /// "wayloc://friend/" and the record's unformatted handle as it stands, nothing escaped. Never none.
    std::optional<platform::Url> urlForTouch() override;
    /// The least height that the row's constraints allow at its present width, points.
    double estimagedHeightForView() override;
    platform::AccessibilityRole accessibilityRole() const override { return platform::AccessibilityRole::Link; }
    /// The whole row in one line that begins with the person; the same at every text size.
    std::string accessibilityText() const override;
    /// None for the user's own row.
    std::optional<platform::AccessibilitySubject> accessibilitySubject() const override;

    /// The source of the user's own position, for the distance; held weakly.
    std::shared_ptr<CurrentLocationDelegate> currentLocationDelegate() const { return currentLocationDelegate_.lock(); }
    void setCurrentLocationDelegate(std::weak_ptr<CurrentLocationDelegate> delegate) {
        currentLocationDelegate_ = std::move(delegate);
    }
    std::shared_ptr<KTRVALocation> location() const { return location_; }
    /// Always fills the row anew, also for the record that it has: time has passed.
    virtual void setLocation(std::shared_ptr<KTRVALocation> location);
    /// A fresh position is awaited (true from the start): words the place text only, at the next filling.
    bool isRefreshingLocation() const { return isRefreshingLocation_; }
    void setIsRefreshingLocation(bool isRefreshing) { isRefreshingLocation_ = isRefreshing; }
    /// The row is the user's own in the show/hide-my-location snippet: no distance is shown.
    bool isVisibility() const { return isVisibility_; }
    void setIsVisibility(bool isVisibility) { isVisibility_ = isVisibility; }

    std::shared_ptr<platform::Label> nameLabel() const { return nameLabel_; }
    void setNameLabel(std::shared_ptr<platform::Label> label) { nameLabel_ = std::move(label); }
    std::shared_ptr<platform::Label> locationLabel() const { return locationLabel_; }
    void setLocationLabel(std::shared_ptr<platform::Label> label) { locationLabel_ = std::move(label); }
    std::shared_ptr<platform::Label> timeLabel() const { return timeLabel_; }
    void setTimeLabel(std::shared_ptr<platform::Label> label) { timeLabel_ = std::move(label); }
    std::shared_ptr<platform::Label> distanceLabel() const { return distanceLabel_; }
    void setDistanceLabel(std::shared_ptr<platform::Label> label) { distanceLabel_ = std::move(label); }
    /// Kept for subclasses; this row does not consult it.
    bool constraintSetupCompleted() const { return constraintSetupCompleted_; }
    void setConstraintSetupCompleted(bool completed) { constraintSetupCompleted_ = completed; }

  protected:
    /// Looks the friend's contact up and hands it to the avatar 0.1 seconds later.
    void updateAvatar();
    /// The texts of the row as they stand now; "" for what is not known.
    std::string nameText() const;
    std::string placeText() const;
    std::string distanceText() const;
    /// Shown and spoken; both empty without a date.
    KTRVAUIUtils::AgeStrings ageTexts() const;

  private:
    std::shared_ptr<platform::PlatformLocation> userLocation() const;
    void setupLabels();
    void setupConstraints();
    void updatePlace();
    void updateAge();
    void updateDistance();

    bool isRefreshingLocation_ = false;
    bool isVisibility_ = false;
    bool constraintSetupCompleted_ = false;
    std::weak_ptr<CurrentLocationDelegate> currentLocationDelegate_;
    std::shared_ptr<KTRVALocation> location_;
    std::shared_ptr<platform::Label> nameLabel_;
    std::shared_ptr<platform::Label> locationLabel_;
    std::shared_ptr<platform::Label> timeLabel_;
    std::shared_ptr<platform::Label> distanceLabel_;
    platform::NotificationCenter::Token currentLocationUpdated_;
};

}  // namespace ktr
