#pragma once

#include <filesystem>
#include <memory>

#include "linux/configuration/Configuration.h"
#include "linux/maps/ThreadedMapSource.h"
#include "linux/net/NetworkThread.h"

namespace ktr::linux_ {

/// The maps that the configuration names, behind them those that were added, and behind these the built-in world, which
/// draws whatever they leave. Main thread.
class ConfiguredMaps {
  public:
    /// `resourceFolder`: where "maps" with the built-in data stands. Pictures are fetched on `network`; none: each
    /// source has a thread of its own.
    static std::shared_ptr<ThreadedMapSource> make(const Configuration& configuration,
                                                   const std::filesystem::path& resourceFolder,
                                                   std::shared_ptr<platform::MainLoop> mainLoop,
                                                   const std::shared_ptr<NetworkThread>& network = nullptr);
    /// The same as grounds, for `ThreadedMapSource::setGrounds` when the configuration has changed.
    static ThreadedMapSource::Grounds grounds(const Configuration& configuration,
                                              const std::filesystem::path& resourceFolder,
                                              const std::shared_ptr<NetworkThread>& network = nullptr);
};

}  // namespace ktr::linux_
