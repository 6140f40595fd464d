#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "host/live/SeenRequests.h"
#include "host/live/ServiceLanes.h"
#include "host/live/ServiceWatch.h"
#include "linux/configuration/Configuration.h"
#include "linux/configuration/ConfigurationWatcher.h"
#include "linux/configuration/ConfiguredAccountStore.h"
#include "linux/configuration/FilePreferences.h"
#include "linux/device/EvenClock.h"
#include "linux/device/LogindLock.h"
#include "linux/maps/ThreadedMapSource.h"
#include "linux/net/AssistantClient.h"
#include "linux/net/NetworkThread.h"
#include "platform/base/Platform.h"

namespace ktr::host {

/// What stands behind a conversation that is live: the account, the way to its service and to the assistant, and the
/// user's position. It goes before the platform's main loop does. Main thread.
class LiveServices {
  public:
    /// Reads the configuration; the app token, which may have to wait for a keyring, is read in the background once the
    /// platform is installed (`start`), and is told to `secrets`.
    LiveServices(std::filesystem::path configurationFile, std::shared_ptr<linux_::KnownSecrets> secrets);
    ~LiveServices();
    LiveServices(const LiveServices&) = delete;
    LiveServices& operator=(const LiveServices&) = delete;

    /// As last reported to the platform.
    const linux_::Configuration& configuration() const { return configuration_; }
    /// What was wrong with the configuration or the token at the last reading, in one line; empty when nothing was.
    std::string problem() const { return accounts_->problem(); }
    /// The configuration itself is broken, and none from before stands in for it. The cause stands in the log.
    bool isUnusable() const { return accounts_->isBroken() && !isSignedIn(); }

    /// Sets the members that lead to account, service and position. The platform's loop, clock and geodesy are set
    /// already. With `ownPositions` its location managers are left as they are. Called again for the platform that
    /// takes another's place, with what the configuration says by then: what did not change goes on.
    void addTo(platform::Platform& platform, const std::string& language, bool ownPositions);
    /// Reads the account in the background, and again whenever its files change. `ready` is called once, when the first
    /// reading has ended, well or not, and it is known whether the session is locked.
    void start(std::function<void()> ready);
    /// Reads it again now, whether or not a file has changed: a keyring may hold something else.
    void readAgain() { watcher_->reload(); }
    /// Called when account, token, language, contacts or anything else has changed that a platform is asked only once:
    /// it wants another platform, with the configuration as it is now.
    void setOutdated(std::function<void()> outdated) { outdated_ = std::move(outdated); }
    /// Takes over the configuration as it was read last; whether anything but the list of contacts has changed.
    bool takeConfiguration();

    /// Ends all commands under way, and what waits to be seen.
    void cancelCommands() {
        requests_->cancelHeld();
        lanes_->cancelAll();
    }
    /// Whether somebody sees the cards (`SeenRequests`); so it is at first.
    void setSeen(bool seen) { requests_->setSeen(seen); }
    /// Whether a page covers the cards (`SeenRequests::setCover`); none: not.
    void setCover(SeenRequests::IsThePages cover) { requests_->setCover(std::move(cover)); }
    /// Whether the session is locked; `changed` is called after that may have become another.
    bool isLocked() const { return deviceLock_->lockState() == platform::DeviceLock::kLocked; }
    void setLockChanged(std::function<void()> changed) { deviceLock_->setChanged(std::move(changed)); }
    /// Lets commands show the user, or ends those that do (`ServiceLanes`).
    void openSharing() { lanes_->openSharing(); }
    void closeSharing() { lanes_->closeSharing(); }

    /// Has this source draw what the configuration names whenever that changes; the datum stays as it was made.
    void drawConfiguredMaps(std::shared_ptr<linux_::ThreadedMapSource> maps);

    /// Whether there is an account with a host and a token.
    bool isSignedIn() const;
    /// Whether somebody tells where the user is.
    bool looksForPosition() const { return looksForPosition_; }
    const std::shared_ptr<linux_::NetworkThread>& network() const { return network_; }
    const ServiceWatch& service() const { return *service_; }
    /// What ages are counted by; the moments of `service` are its.
    const linux_::EvenClock& evenClock() const { return *evenClock_; }
    /// Whether the account names an assistant's server, which is asked instead of the engine.
    bool hasAssistant() const;
    linux_::AssistantClient& assistant() { return *assistant_; }
    /// Called after something that the user gets to see may have changed.
    void setChanged(std::function<void()> changed);

  private:
    /// What stays for as long as the conversation does.
    void makeOnce(const platform::Platform& platform);
    void configurationChanged();

    const std::filesystem::path file_;
    linux_::Configuration configuration_;
    /// Of the platform that there is: the account as it found it.
    std::shared_ptr<platform::DeviceOwnerAccount> account_;
    std::shared_ptr<linux_::ConfiguredAccountStore> accounts_;
    std::shared_ptr<platform::MainLoop> mainLoop_;
    std::shared_ptr<linux_::FilePreferences> preferences_;
    std::shared_ptr<platform::DeviceInformation> deviceInformation_;
    std::shared_ptr<linux_::LogindLock> deviceLock_;
    std::shared_ptr<platform::LocationManagerFactory> positions_;
    linux_::Configuration::Positions positionsMade_;
    std::shared_ptr<linux_::EvenClock> evenClock_;
    /// Everything that is said over the network is said on it.
    std::shared_ptr<linux_::NetworkThread> network_ = std::make_shared<linux_::NetworkThread>();
    std::shared_ptr<ServiceLanes> lanes_;
    std::shared_ptr<ServiceWatch> service_;
    std::shared_ptr<SeenRequests> requests_;
    std::string language_;
    std::unique_ptr<linux_::AssistantClient> assistant_;
    std::unique_ptr<linux_::ConfigurationWatcher> watcher_;
    std::shared_ptr<linux_::ThreadedMapSource> maps_;
    std::function<void()> changed_;
    std::function<void()> outdated_;
    bool looksForPosition_ = false;
    /// Tells work in the background whether this still stands.
};

}  // namespace ktr::host
