#pragma once

#include <memory>
#include <string>

#include "platform/base/Bundle.h"

namespace ktr {

/// The plugin's own bundle: its texts, its images and its log carry this identifier. One per installed platform.
class PluginBundle : public platform::Bundle {
  public:
    PluginBundle() : platform::Bundle(platform::kSnippetsBundle) {}
    static std::shared_ptr<PluginBundle> makeShared() { return std::make_shared<PluginBundle>(); }
    /// None without a platform. Any thread.
    static std::shared_ptr<platform::Bundle> bundle();
};

/// The localized text of a key in the plugin's own bundle, default table; the key itself when it has no text. Main
/// thread.
std::string AssistantLocalizedString(const std::string& key);

}  // namespace ktr
