#include "model/PluginBundle.h"

#include "platform/assistant/Localization.h"
#include "platform/base/CurrentPlatform.h"
#include "platform/base/Platform.h"

namespace ktr {

std::shared_ptr<platform::Bundle> PluginBundle::bundle() {
    return platform::shared<PluginBundle>();
}

std::string AssistantLocalizedString(const std::string& key) {
    return platform::currentPlatform()->localization->text(key, platform::kSnippetsBundle);
}

}  // namespace ktr
