#pragma once

#include <QObject>
#include <functional>
#include <memory>

#include "linux/configuration/ConfiguredAccountStore.h"
#include "platform/base/MainLoop.h"

class QFileSystemWatcher;

namespace ktr::linux_ {

/// Loads an account store again in the background when its configuration or token file changes. Main thread.
class ConfigurationWatcher {
  public:
    /// `changed` is called on the main thread when the store holds something new. The store is kept
    /// until a load under way has ended; the loop outlives the watcher.
    ConfigurationWatcher(std::shared_ptr<ConfiguredAccountStore> store, std::shared_ptr<platform::MainLoop> mainLoop,
                         std::function<void()> changed);
    ~ConfigurationWatcher();
    ConfigurationWatcher(const ConfigurationWatcher&) = delete;
    ConfigurationWatcher& operator=(const ConfigurationWatcher&) = delete;

    /// Loads in the background now, whether or not anything changed.
    void reload();

  private:
    struct State;
    static void reload(const std::shared_ptr<State>& state);
    static void watch(const std::shared_ptr<State>& state);
    std::shared_ptr<State> state_;
};

}  // namespace ktr::linux_
