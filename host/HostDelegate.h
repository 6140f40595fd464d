#pragma once

#include <functional>
#include <memory>

#include "platform/host/SnippetHostDelegate.h"

namespace ktr::host {

/// What the host does for the controllers of a conversation: handlers that the program's commands fill in. Main thread.
class HostDelegate : public platform::SnippetHostDelegate {
  public:
    explicit HostDelegate(std::shared_ptr<platform::Bundle> bundle) : bundle_(std::move(bundle)) {}

    /// Opens a URL; whether it was opened. Without one no URL is opened.
    std::function<bool(const platform::Url&)> open;
    /// A controller's height changed; with the flag the top of its card stays where it is on screen.
    std::function<void(platform::HostSnippetViewController&, bool pinTop)> resize;

    std::shared_ptr<platform::Bundle> effectiveBundleForLocation(platform::HostSnippetViewController&) override {
        return bundle_;
    }
    void openUrl(platform::HostSnippetViewController&, const platform::Url& url,
                 std::function<void(bool)> completion) override {
        const bool opened = open && open(url);
        if (completion) {
            completion(opened);
        }
    }
    void heightDidChange(platform::HostSnippetViewController& controller, bool pinTopOfSnippet) override {
        if (resize) {
            resize(controller, pinTopOfSnippet);
        }
    }

  private:
    std::shared_ptr<platform::Bundle> bundle_;
};

}  // namespace ktr::host
