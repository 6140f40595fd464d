#pragma once

#include <functional>
#include <string>

#include "app/window/friend/FriendPage.h"
#include "host/links/LinkPolicy.h"
#include "linux/device/DesktopOpener.h"

namespace ktr::app {

/// Takes links where they lead: to a page of this window, or to the desktop; what leads nowhere is said. Main thread.
class LinkOpener {
  public:
    struct Window {
        std::function<void(host::KnownFriends::Known known, FriendPage::Asks asks)> showFriend;
        std::function<void()> showSelf;
        std::function<void()> showFriends;
        std::function<void(const std::string& sentence)> say;
    };

    /// Host and opener outlive this; it outlives what the window's functions use.
    LinkOpener(host::Host& host, linux_::DesktopOpener& desktop, Window window)
        : host_(host), desktop_(desktop), window_(std::move(window)) {}

    /// Whether the link leads anywhere. Whether another program opens it is known later, and said if none does: in the
    /// words with the key `nobody`.
    bool open(const std::string& url, host::LinkPolicy::From from, const char* nobody = "LINK_NOBODY");

  private:
    bool openFriend(const std::string& handle, host::LinkPolicy::From from);

    host::Host& host_;
    linux_::DesktopOpener& desktop_;
    const Window window_;
    std::shared_ptr<LinkOpener*> self_ = std::make_shared<LinkOpener*>(this);
};

}  // namespace ktr::app
