#pragma once

#include "platform/host/HostSnippetViewController.h"

namespace ktr {

/// The plugin's principal class. Main thread.
class KTRSnippetControllerFactory : public platform::SnippetControllerFactory {
  public:
    /// The controller that draws the snippet, owned by the caller. None, and a line in the log, for an object of a kind
    /// that the plugin does not draw.
    std::shared_ptr<platform::HostSnippetViewController> viewControllerForSnippet(
        const std::shared_ptr<platform::AssistantObject>& snippet) override;
    /// Always none: the plugin has no texts for speaking about an object.
    std::shared_ptr<platform::Object> speakableNamespaceProviderForCueObject(
        const std::shared_ptr<platform::AssistantObject>& object) override;
};

}  // namespace ktr
