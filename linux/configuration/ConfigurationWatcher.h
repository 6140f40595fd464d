#pragma once

#include <functional>
#include <memory>

#include "linux/configuration/ConfiguredAccountStore.h"
#include "platform/base/MainLoop.h"

namespace ktr::linux_ {

/// Has an account store read its files in the background, at the start and when its configuration or token file
/// changes, and take what was read. Main thread, which looks at no disk.
class ConfigurationWatcher {
  public:
    /// `changed` is called on the main thread when the store holds something new. The store is kept until a reading
    /// under way has ended; the loop outlives the watcher.
    ConfigurationWatcher(std::shared_ptr<ConfiguredAccountStore> store, std::shared_ptr<platform::MainLoop> mainLoop,
                         std::function<void()> changed);
    ~ConfigurationWatcher();
    ConfigurationWatcher(const ConfigurationWatcher&) = delete;
    ConfigurationWatcher& operator=(const ConfigurationWatcher&) = delete;

    /// Reads for the first time. `done` is called on the main thread in place of `changed`, whatever was read; what
    /// changes meanwhile is read after it.
    void start(std::function<void()> done);
    /// Reads in the background now, whether or not anything changed.
    void reload();

  private:
    struct State;
    static void reload(const std::shared_ptr<State>& state);
    static void taken(const std::shared_ptr<State>& state);
    static void watch(const std::shared_ptr<State>& state);
    std::shared_ptr<State> state_;
};

}  // namespace ktr::linux_
