#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "platform/host/SnippetHostDelegate.h"

namespace ktr::test {

/// A host that remembers what a controller asked of it; URLs are opened when `opens` says so, at once.
struct FakeHost : platform::SnippetHostDelegate {
    std::shared_ptr<platform::Bundle> bundle = std::make_shared<platform::Bundle>("org.ktr.host");
    bool opens = true;
    std::vector<platform::Url> opened;
    /// The pin flag of each height change.
    std::vector<bool> heightChanges;

    std::shared_ptr<platform::Bundle> effectiveBundleForLocation(platform::HostSnippetViewController&) override {
        return bundle;
    }
    void openUrl(platform::HostSnippetViewController&, const platform::Url& url,
                 std::function<void(bool)> completion) override {
        opened.push_back(url);
        completion(opens);
    }
    void heightDidChange(platform::HostSnippetViewController&, bool pinTopOfSnippet) override {
        heightChanges.push_back(pinTopOfSnippet);
    }
};

}  // namespace ktr::test
