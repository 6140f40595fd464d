#include "app/window/LinkOpener.h"

namespace ktr::app {

using host::KnownFriends;
using host::LinkPolicy;

bool LinkOpener::open(const std::string& url, LinkPolicy::From from, const char* nobody) {
    const auto target = LinkPolicy::decide(url, from);
    if (const auto* friend_ = std::get_if<LinkPolicy::Friend>(&target)) {
        return openFriend(friend_->handle, from);
    }
    if (std::holds_alternative<LinkPolicy::Self>(target)) {
        window_.showSelf();
        return true;
    }
    if (std::holds_alternative<LinkPolicy::Friends>(target)) {
        window_.showFriends();
        return true;
    }
    const auto* elsewhere = std::get_if<LinkPolicy::Elsewhere>(&target);
    if (elsewhere == nullptr) {
        window_.say(host_.text("LINK_REFUSED"));
        return false;
    }
    desktop_.open(elsewhere->url, [self = std::weak_ptr(self_), key = std::string(nobody)](bool opened) {
        if (const auto opener = self.lock(); opener && !opened) {
            (*opener)->window_.say((*opener)->host_.text(key));
        }
    });
    return true;
}

bool LinkOpener::openFriend(const std::string& handle, LinkPolicy::From from) {
    // Whoever sends a link learns nothing by it, not even whether the service knows the person.
    const bool isOwnTap = from != LinkPolicy::From::Outside;
    const auto contact = KnownFriends::fromContacts(handle);
    auto known = isOwnTap || contact ? KnownFriends(host_).find(handle) : std::nullopt;
    if (!known) {
        known = contact;
    }
    if (!known) {
        window_.say(host_.text("LINK_UNKNOWN"));
        return false;
    }
    window_.showFriend(std::move(*known), isOwnTap ? FriendPage::Asks::AtOnce : FriendPage::Asks::OnlyOnTap);
    return true;
}

}  // namespace ktr::app
