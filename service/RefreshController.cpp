#include "service/RefreshController.h"

#include "model/LogCategory.h"
#include "model/NumberComparison.h"
#include "platform/base/Assert.h"
#include "platform/base/MainLoop.h"
#include "platform/base/NotificationCenter.h"
#include "platform/base/Platform.h"
#include "service/GetLocationsCmd.h"
#include "service/ShowHideLocationCmd.h"

namespace ktr {

namespace {
/// Metres: the distance filter, and the shortest move that is sent.
constexpr double kDistanceOfNote = 10.0;
/// Degrees: a user who has moved no further rests.
constexpr double kSamePlace = 1e-6;

std::shared_ptr<platform::MainLoop> mainLoop() {
    const auto installed = platform::Platform::installed();
    return installed ? installed->mainLoop : nullptr;
}

/// Deferred work may come to run when the host has taken the platform away, which everything that it leads to asks.
bool isPlatformThere() {
    return platform::Platform::installed() != nullptr;
}

/// What is not known lies at 0, 0, as in the commands.
platform::Coordinate coordinateOf(const std::shared_ptr<platform::PlatformLocation>& location) {
    return location ? location->coordinate() : platform::Coordinate();
}

}  // namespace

RefreshController::~RefreshController() {
    // Nothing virtual, and nothing deferred: what could run later finds the controller gone.
    endCycle();
    delegate_.reset();
    if (locationManager_) {
        locationManager_->stopUpdatingLocation();
    }
}

bool RefreshController::initWithBundle(const std::shared_ptr<platform::Bundle>& bundle) {
    KTR_ASSERT_MAIN_THREAD();
    serverInteractionController_ = std::make_shared<platform::KTServerInteractionController>();
    locationManager_ = platform::Platform::installed()->locationManagers->makeManager(bundle);
    locationManager_->setDelegate(platform::weak(this));
    locationManager_->setDesiredAccuracy(platform::kLocationAccuracyNearestTenMeters);
    locationManager_->setDistanceFilter(kDistanceOfNote);
    locationManager_->startUpdatingLocation();
    currentLocation_ = locationManager_->location();
    return true;
}

void RefreshController::beginTimerWithRefresh(double refresh, double timeout) {
    KTR_ASSERT_MAIN_THREAD();
    LogCategory_Unspecified()->line("Begining timerWithRefresh: %0.0f timeout:%0.0f", refresh, timeout);
    // Unconditionally: a first refresh follows even when the time is over at once.
    scheduleTimerWithInterval(refresh);
    timeout_ = timeout;
    if (timeout_ > 0.0) {
        if (const auto loop = mainLoop()) {
            loop->schedule(timeout, false, [controller = platform::weak(this)] {
                if (const auto self = controller.lock(); self && isPlatformThere()) {
                    self->cancelTimer();
                }
            });
        }
    } else {
        timeout_ = 0.0;
        refresherCancelled_ = true;
    }
}

void RefreshController::scheduleTimerWithInterval(double interval) {
    KTR_ASSERT_MAIN_THREAD();
    LogCategory_Unspecified()->line("Rescheduling timer with refresh in: %0.0f seconds", interval);
    const auto loop = mainLoop();
    if (!loop) {
        return;
    }
    // The timer that is replaced here goes on and fires.
    const auto itself = std::make_shared<std::weak_ptr<platform::Timer>>();
    pollTimer_ = loop->schedule(interval, false, [controller = platform::weak(this), itself] {
        if (const auto self = controller.lock(); self && isPlatformThere()) {
            self->timerFired(itself->lock());
        }
    });
    *itself = pollTimer_;
}

void RefreshController::timerFired(const std::shared_ptr<platform::Timer>& /*timer*/) {
    if (isVisibilityRefresh_) {
        refreshVisibility();
        return;
    }
    LogCategory_Unspecified()->line("Refreshing friend location.");
    refreshLocations();
}

void RefreshController::refreshLocations() {
    KTR_ASSERT_MAIN_THREAD();
    LogCategory_Unspecified()->line("Sending location refresh command");
    const auto command = platform::create<GetLocationsCmd>(&GetLocationsCmd::init);
    if (!command) {
        return;
    }
    const auto asked = delegate();
    if (asked) {
        command->setClientId(asked->clientId());
        command->setFriends(asked->friends());
    }
    command->setCurrentLocation(currentLocation_);
    if (asked) {
        command->setProximity(asked->proximity());
    }
    sendCommand(command);
}

void RefreshController::refreshVisibility() {
    KTR_ASSERT_MAIN_THREAD();
    LogCategory_Unspecified()->line("Sending visibility refresh command");
    if (lastRefreshLocation_) {
        const auto now = coordinateOf(currentLocation_);
        const auto last = lastRefreshLocation_->coordinate();
        if (isCloseToNumber(now.latitude, last.latitude, kSamePlace) &&
            isCloseToNumber(now.longitude, last.longitude, kSamePlace)) {
            LogCategory_Unspecified()->line("Skipping visibility refresh, current location hasn't changed");
            return;
        }
    }
    const auto command = platform::create<ShowHideLocationCmd>(&ShowHideLocationCmd::init);
    if (!command) {
        return;
    }
    command->setCurrentLocation(currentLocation_);
    command->setHideLocation(false);
    // Before it is sent: what counts is what the service was last told, not whether it heard.
    lastRefreshLocation_ = currentLocation_;
    sendCommand(command);
}

void RefreshController::sendCommand(const std::shared_ptr<KTRBaseCmd>& command) {
    const auto loop = mainLoop();
    if (!serverInteractionController_ || !loop) {
        return;
    }
    // Command and controller are kept until the answer has been handled, also when the snippet is gone by then: a
    // request under way is completed. The sender lets go of both on the main thread.
    serverInteractionController_->sendCommand(command, [self = platform::strong(this), command, loop] {
        if (command->wasSuccessful()) {
            loop->post([self, command] {
                if (isPlatformThere()) {
                    self->handleAnswer(*command);
                }
            });
        }
        command->setCompletionBlock(nullptr);
    });
}

void RefreshController::handleAnswer(KTRBaseCmd& command) {
    const auto result = std::make_shared<const ServiceResult>(command.result().value_or(ServiceResult()));
    const double interval = command.minCallbackInterval();
    if (interval > 0.0 && !refresherCancelled_) {
        scheduleTimerWithInterval(interval);
    }
    if (const auto told = delegate()) {
        told->locationsUpdated(result);
    }
    // Exactly 0, also when no start ever ran.
    if (timeout_ == 0.0) {
        LogCategory_Unspecified()->line("timeout is 0, informing the delegate of cancellation after first callback");
        if (const auto told = delegate()) {
            told->refreshCancelled();
        }
    }
}

void RefreshController::cancelTimer() {
    KTR_ASSERT_MAIN_THREAD();
    endCycle();
}

void RefreshController::endCycle() {
    LogCategory_Unspecified()->line("Cancelling_Timer");
    refresherCancelled_ = true;
    if (const auto told = delegate()) {
        told->refreshCancelled();
    }
    if (pollTimer_) {
        pollTimer_->invalidate();
    }
    if (locationManager_) {
        locationManager_->stopUpdatingLocation();
    }
}

void RefreshController::didUpdateLocations(platform::PlatformLocationManager& /*manager*/,
                                           const platform::PlatformLocations& locations) {
    KTR_ASSERT_MAIN_THREAD();
    if (locations.empty() || !locations.back()) {
        return;
    }
    const auto previous = std::move(currentLocation_);
    currentLocation_ = locations.back();
    const double metres = previous ? currentLocation_->distanceFromLocation(*previous) : 0.0;
    const auto installed = platform::Platform::installed();
    if (metres > kDistanceOfNote && installed) {
        installed->notificationCenter->post({kCurrentLocationUpdatedNotification, platform::strong(this)});
    }
}

}  // namespace ktr
