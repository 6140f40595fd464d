#pragma once

#include <memory>

#include "platform/base/Bundle.h"
#include "platform/base/Object.h"
#include "platform/base/Timer.h"
#include "platform/client/KTServerInteractionController.h"
#include "platform/location/PlatformLocationManager.h"
#include "service/KTRBaseCmd.h"
#include "service/RefreshControllerDelegate.h"
#include "views/CurrentLocationDelegate.h"

namespace ktr {

/// Keeps a snippet live while it is on screen: asks the service again and again, at the pace that the service sets,
/// until an overall timeout; for the snippet about the user's own sharing it tells the service where the user is
/// instead, as long as the user moves. It tracks the user's own position, posting kCurrentLocationUpdatedNotification,
/// itself the sender, when the user has moved more than 10 metres since the last position. Seconds throughout. Main
/// thread.
class RefreshController : public platform::Object,
                          public CurrentLocationDelegate,
                          public platform::PlatformLocationManagerDelegate {
  public:
    /// Ends refreshing as `cancelTimer` does; a delegate that is still there hears it.
    ~RefreshController() override;

    /// Starts position updates in the name of this bundle (may be none), and takes over the position that is already
    /// known. Nothing is sent yet.
    virtual bool initWithBundle(const std::shared_ptr<platform::Bundle>& bundle);

    /// Refreshes after `refresh` seconds and from then on when the service wants it; `cancelTimer` follows after
    /// `timeout` seconds. A timeout of 0 or less: one refresh, whose answer is followed by `refreshCancelled`. Starting
    /// again does not stop what an earlier start has armed: two starts lead to two refreshes and two cancellations,
    /// deliberately.
    virtual void beginTimerWithRefresh(double refresh, double timeout);
    /// Ends refreshing for good: a later start has one answer delivered and nothing armed after it. The delegate hears
    /// it at every call. What an earlier start has asked for is deliberately not withdrawn.
    virtual void cancelTimer();
    /// Arms one timer; the one in `pollTimer` is replaced and deliberately goes on.
    virtual void scheduleTimerWithInterval(double interval);
    /// `refreshVisibility` or `refreshLocations`, as `isVisibilityRefresh` says now.
    virtual void timerFired(const std::shared_ptr<platform::Timer>& timer);
    /// Sends one command. When it succeeds, the delegate gets its result and the next timer is armed with the service's
    /// interval; when it fails, nothing happens: polling ends until the next start.
    virtual void refreshLocations();
    /// Sends one command that shows the user's location at the present position; its answer is handled in the same way.
    /// Nothing is sent, and no timer armed, while the user is where the last command said, within a millionth of a
    /// degree: polling deliberately ends at the first tick at which the user rests.
    virtual void refreshVisibility();

    /// The snippet is about the user's own sharing.
    bool isVisibilityRefresh() const { return isVisibilityRefresh_; }
    void setIsVisibilityRefresh(bool visibility) { isVisibilityRefresh_ = visibility; }
    bool refresherCancelled() const { return refresherCancelled_; }
    void setRefresherCancelled(bool cancelled) { refresherCancelled_ = cancelled; }
    std::shared_ptr<RefreshControllerDelegate> delegate() const { return delegate_.lock(); }
    void setDelegate(std::weak_ptr<RefreshControllerDelegate> delegate) { delegate_ = std::move(delegate); }
    /// The timer armed last; may be none.
    const std::shared_ptr<platform::Timer>& pollTimer() const { return pollTimer_; }
    void setPollTimer(std::shared_ptr<platform::Timer> timer) { pollTimer_ = std::move(timer); }
    double timeout() const { return timeout_; }
    void setTimeout(double timeout) { timeout_ = timeout; }
    const std::shared_ptr<platform::KTServerInteractionController>& serverInteractionController() const {
        return serverInteractionController_;
    }
    void setServerInteractionController(std::shared_ptr<platform::KTServerInteractionController> controller) {
        serverInteractionController_ = std::move(controller);
    }
    std::shared_ptr<platform::PlatformLocation> currentLocation() const override { return currentLocation_; }
    void setCurrentLocation(std::shared_ptr<platform::PlatformLocation> location) {
        currentLocation_ = std::move(location);
    }
    /// The position that the last visibility command was given, whether or not it arrived; none before the first one,
    /// and after one that knew no position.
    const std::shared_ptr<platform::PlatformLocation>& lastRefreshLocation() const { return lastRefreshLocation_; }
    void setLastRefreshLocation(std::shared_ptr<platform::PlatformLocation> location) {
        lastRefreshLocation_ = std::move(location);
    }
    const std::shared_ptr<platform::PlatformLocationManager>& locationManager() const { return locationManager_; }
    void setLocationManager(std::shared_ptr<platform::PlatformLocationManager> manager) {
        locationManager_ = std::move(manager);
    }

    /// Takes over the newest, the last of the list. The first position after none posts nothing.
    void didUpdateLocations(platform::PlatformLocationManager& manager,
                            const platform::PlatformLocations& locations) override;

  private:
    void endCycle();
    void sendCommand(const std::shared_ptr<KTRBaseCmd>& command);
    void handleAnswer(KTRBaseCmd& command);

    bool isVisibilityRefresh_ = false;
    bool refresherCancelled_ = false;
    std::weak_ptr<RefreshControllerDelegate> delegate_;
    std::shared_ptr<platform::Timer> pollTimer_;
    std::shared_ptr<platform::PlatformLocationManager> locationManager_;
    std::shared_ptr<platform::PlatformLocation> currentLocation_;
    std::shared_ptr<platform::PlatformLocation> lastRefreshLocation_;
    double timeout_ = 0.0;
    std::shared_ptr<platform::KTServerInteractionController> serverInteractionController_;
};

}  // namespace ktr
