#pragma once

#include <string>
#include <vector>

namespace ktr::host {

/// Where the plugin is looked for. Any thread.
class PluginFinder {
  public:
    /// The path that was asked for, by whoever starts the program or else by the environment's KTR_PLUGIN, as it
    /// stands; without one the first place that holds libktr-snippets.so; the first place of all when none does.
    static std::string find(const std::string& asked);
    /// In the order of looking: beside the program, `../lib` of its folder, the folder of the installation.
    static std::vector<std::string> places();
};

}  // namespace ktr::host
