#pragma once

#include <memory>
#include <string>
#include <variant>

#include "platform/host/PluginInterface.h"

namespace ktr::host {

/// A loaded plugin and its principal object. The library stays in the process for good: deferred work of the plugin may
/// outlive the object. Everything that came from the factory is dropped before this is. Main thread.
class Plugin {
  public:
    /// Loads the library at `path` and makes its principal object for the installed platform; else one line that says
    /// why not. A library whose ABI number differs is refused before anything else of it is used.
    static std::variant<std::unique_ptr<Plugin>, std::string> load(const std::string& path);
    ~Plugin();
    Plugin(const Plugin&) = delete;
    Plugin& operator=(const Plugin&) = delete;

    platform::SnippetControllerFactory& factory() const { return *factory_; }
    const std::string& bundleIdentifier() const { return bundleIdentifier_; }
    const std::string& version() const { return version_; }

  private:
    Plugin() = default;

    platform::SnippetControllerFactory* factory_ = nullptr;
    ktr_plugin_destroy_function destroy_ = nullptr;
    std::string bundleIdentifier_;
    std::string version_;
};

}  // namespace ktr::host
