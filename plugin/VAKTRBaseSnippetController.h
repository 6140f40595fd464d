#pragma once

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "model/KTRVALocation.h"
#include "platform/assistant/VASnippet.h"
#include "platform/base/Timer.h"
#include "platform/base/Value.h"
#include "platform/host/HostSnippetViewController.h"
#include "platform/ui/StackView.h"
#include "service/RefreshController.h"
#include "views/FriendViewDelegate.h"
#include "views/KTRVelaFriendView.h"
#include "views/ViewURLHandler.h"

namespace ktr {

/// What the snippet controllers share: the snippet's inputs, the refresh controller, the timer that redraws the rows,
/// the header, and the ways to the host. A subclass adds its rows in `loadView` and redraws them in `reloadData`. Main
/// thread.
class VAKTRBaseSnippetController : public platform::HostSnippetViewController,
                                   public RefreshControllerDelegate,
                                   public ViewURLHandler,
                                   public FriendViewDelegate {
  public:
    using Locations = std::vector<std::shared_ptr<KTRVALocation>>;

    /// Seconds between two redrawings of a snippet on screen: ages are shown in minutes, half a minute keeps them true.
    static constexpr double kReloadInterval = 30.0;

    /// Ends refreshing, and is not told of it.
    ~VAKTRBaseSnippetController() override;

    /// False when the base cannot be made.
    virtual bool initWithCueObject(const std::shared_ptr<platform::VASnippet>& snippet);

    // What the host calls
    /// Makes a refresh controller for the delegate's location bundle, and with a context starts it with the context's
    /// intervals; `viewWillAppear` deliberately starts it once more. A refresh controller from before is let go without
    /// being cancelled. None leaves what there is running.
    void setDelegate(const std::shared_ptr<platform::SnippetHostDelegate>& delegate) override;
    void loadView() override;
    /// Pins the view's edges to its superview's, with new constraints at every call; nothing without a superview.
    void updateViewConstraints() override;
    void viewWillAppear(bool animated) override;
    void viewWillDisappear(bool animated) override;
    /// Points. The base answers with the container's smallest height.
    double desiredHeightForWidth(double width) override;
    std::shared_ptr<platform::HeaderItem> sashItem() override;
    /// Of friends' locations: the snippet with those of the last answer in their place.
    std::shared_ptr<platform::AssistantObject> currentSnippet() const override;

    /// Redraws the rows; the base has none.
    virtual void reloadData();
    /// Fresh locations from the service: redraws, and tells the host. What is no friend's location becomes a record
    /// without an assistant object.
    void locationsUpdated(const std::shared_ptr<const ServiceResult>& result) override;
    /// Refreshing has ended. Remembered for the next `reloadData`; nothing is redrawn now.
    void refreshCancelled() override;
    void viewNeedsResize() override;
    void handleURL(const platform::Url& url) override;
    /// Has the host open the URL; a failure is an error line in the log and nothing else.
    virtual void openURL(const platform::Url& url);

    bool refreshingCancelled() const { return refreshingCancelled_; }
    void setRefreshingCancelled(bool cancelled) { refreshingCancelled_ = cancelled; }
    /// The service's identifier of this conversation, from the context; may be none.
    std::optional<std::string> clientId() const override { return clientId_; }
    void setClientId(std::optional<std::string> clientId) { clientId_ = std::move(clientId); }
    /// The friends' records in the assistant's or the service's order. Valid until the next `setLocations`.
    const Locations& locations() const { return locations_; }
    /// Wraps each object in a record. The very list that was given last changes nothing, and its records stay. None is
    /// an empty list.
    void setLocations(const std::shared_ptr<const platform::LocationList>& locations);
    /// The persons whose locations are asked for: one a record, records without a person left out.
    std::vector<std::shared_ptr<platform::VAPerson>> friends() const override;
    /// The first location, whatever it holds, or none. What was stored is not read.
    std::shared_ptr<KTRVALocation> disambiguatedLocation() const;
    void setDisambiguatedLocation(std::shared_ptr<KTRVALocation> location) { storedLocation_ = std::move(location); }
    std::optional<std::string> proximity() const override { return proximity_; }
    void setProximity(std::optional<std::string> proximity) { proximity_ = std::move(proximity); }
    std::shared_ptr<platform::StackView> containerView() const { return containerView_; }
    void setContainerView(std::shared_ptr<platform::StackView> container) { containerView_ = std::move(container); }
    /// The service's context; none when the snippet has none.
    const std::optional<platform::Dictionary>& contextDict() const { return contextDict_; }
    void setContextDict(std::optional<platform::Dictionary> context) { contextDict_ = std::move(context); }
    std::shared_ptr<RefreshController> refreshController() const { return refreshController_; }
    void setRefreshController(std::shared_ptr<RefreshController> controller) {
        refreshController_ = std::move(controller);
    }
    /// The width last asked of `desiredHeightForWidth`, points; rows are made this wide.
    double currentWidth() const { return currentWidth_; }
    void setCurrentWidth(double width) { currentWidth_ = width; }
    std::shared_ptr<platform::Timer> reloadTimer() const { return reloadTimer_; }
    void setReloadTimer(std::shared_ptr<platform::Timer> timer) { reloadTimer_ = std::move(timer); }
    /// Seconds until the first refresh.
    double refreshInterval() const { return refreshInterval_; }
    void setRefreshInterval(double seconds) { refreshInterval_ = seconds; }
    /// Seconds that refreshing goes on.
    double timeoutInterval() const { return timeoutInterval_; }
    void setTimeoutInterval(double seconds) { timeoutInterval_ = seconds; }

  protected:
    /// A friend's row, the accessibility row when `axSize`, as wide as the controller and 0 high, placed by
    /// constraints.
    std::shared_ptr<KTRVelaFriendView> makeFriendRow(bool axSize) const;

  private:
    void startReloadTimer();

    /// What the controller was made of; may be none.
    std::shared_ptr<platform::VASnippet> snippet_;
    bool refreshingCancelled_ = false;
    std::optional<std::string> clientId_;
    /// The list that `locations_` was made of, to know it again.
    std::shared_ptr<const platform::LocationList> sourceLocations_;
    Locations locations_;
    std::shared_ptr<KTRVALocation> storedLocation_;
    std::optional<std::string> proximity_;
    std::shared_ptr<platform::StackView> containerView_;
    std::optional<platform::Dictionary> contextDict_;
    std::shared_ptr<RefreshController> refreshController_;
    double currentWidth_ = 0.0;
    std::shared_ptr<platform::Timer> reloadTimer_;
    double refreshInterval_ = 0.0;
    double timeoutInterval_ = 0.0;
};

}  // namespace ktr
