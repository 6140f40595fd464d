#pragma once

#include <functional>
#include <memory>

#include "platform/base/Bundle.h"
#include "platform/base/Url.h"

namespace ktr::platform {

class HostSnippetViewController;

/// What a host does for a snippet's controller. Main thread.
class KTR_API SnippetHostDelegate {
  public:
    virtual ~SnippetHostDelegate();
    /// The bundle under which this controller may use location services; may be none.
    virtual std::shared_ptr<Bundle> effectiveBundleForLocation(HostSnippetViewController& controller) = 0;
    /// Opens the URL; the completion hears whether it was opened, at once or later, once, on the main thread.
    virtual void openUrl(HostSnippetViewController& controller, const Url& url,
                         std::function<void(bool)> completion) = 0;
    /// The controller's height changed. With `pinTopOfSnippet` the snippet's top stays where it is on screen.
    virtual void heightDidChange(HostSnippetViewController& controller, bool pinTopOfSnippet) = 0;
};

}  // namespace ktr::platform
