#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "host/live/ServiceWatch.h"
#include "linux/configuration/Configuration.h"
#include "linux/configuration/ConfigurationWatcher.h"
#include "linux/configuration/ConfiguredAccountStore.h"
#include "linux/maps/ThreadedMapSource.h"
#include "linux/net/AssistantClient.h"
#include "platform/base/Platform.h"

namespace ktr::host {

/// What stands behind a conversation that is live: the account, the way to its service and to the assistant, and the
/// user's position. It goes before the platform's main loop does. Main thread.
class LiveServices {
  public:
    /// Reads the configuration; the app token, which may have to wait for a keyring, is read in the background once the
    /// platform is installed (`start`).
    explicit LiveServices(std::filesystem::path configurationFile);
    ~LiveServices();
    LiveServices(const LiveServices&) = delete;
    LiveServices& operator=(const LiveServices&) = delete;

    /// As it was when the program started.
    const linux_::Configuration& configuration() const { return configuration_; }
    /// What was wrong with the configuration or the token at the last reading, in one line; empty when nothing was.
    std::string problem() const { return accounts_->problem(); }

    /// Sets the members that lead to account, service and position. The platform's loop, clock and geodesy are set
    /// already. With `ownPositions` its location managers are left as they are.
    void addTo(platform::Platform& platform, const std::string& language, bool ownPositions);
    /// Reads the account in the background, and again whenever its files change. `ready` is called once, when the first
    /// reading has ended, well or not.
    void start(std::function<void()> ready);

    /// Has this source draw what the configuration names whenever that changes; the datum stays as it was made.
    void drawConfiguredMaps(std::shared_ptr<linux_::ThreadedMapSource> maps);

    /// Whether there is an account with a host and a token.
    bool isSignedIn() const;
    /// Whether somebody tells where the user is.
    bool looksForPosition() const { return looksForPosition_; }
    const ServiceWatch& service() const { return *service_; }
    linux_::AssistantClient& assistant() { return *assistant_; }
    /// Called after something that the user is told of may have changed.
    void setChanged(std::function<void()> changed);

  private:
    void configurationChanged();

    const std::filesystem::path file_;
    linux_::Configuration configuration_;
    std::shared_ptr<linux_::ConfiguredAccountStore> accounts_;
    std::shared_ptr<platform::MainLoop> mainLoop_;
    std::shared_ptr<ServiceWatch> service_;
    std::unique_ptr<linux_::AssistantClient> assistant_;
    std::unique_ptr<linux_::ConfigurationWatcher> watcher_;
    std::shared_ptr<linux_::ThreadedMapSource> maps_;
    std::function<void()> changed_;
    bool looksForPosition_ = false;
    /// Tells work in the background whether this still stands.
    std::shared_ptr<bool> alive_ = std::make_shared<bool>(true);
};

}  // namespace ktr::host
