// Where links lead from a conversation's window.
#include "app/window/ConversationWindow.h"
#include "app/window/friend/FriendsPage.h"
#include "app/window/friend/SelfPage.h"

namespace ktr::app {

using host::LinkPolicy;

void ConversationWindow::openLinks(linux_::DesktopOpener& desktop) {
    links_ = std::make_unique<LinkOpener>(
        host_, desktop,
        LinkOpener::Window{
            [this](const host::KnownFriends::Known& known, FriendPage::Asks asks) { showFriend(known, asks); },
            [this] { showSelf(); }, [this] { showFriends(); }, [this](const std::string& words) { say(words); }});
    host_.delegate().open = [this](const platform::Url& url) {
        return links_->open(url.text(), LinkPolicy::From::Conversation);
    };
}

void ConversationWindow::open(const std::string& url, LinkPolicy::From from) {
    if (links_) {
        links_->open(url, from);
    }
}

void ConversationWindow::say(const std::string& sentence) {
    notice_->place(pages_->isOpen() ? 0 : barHeight());
    notice_->say(QString::fromStdString(sentence));
}

void ConversationWindow::showFriend(const host::KnownFriends::Known& known, FriendPage::Asks asks) {
    pages_->open(std::make_unique<FriendPage>(host_, known, asks, [this](const std::string& url, const char* nobody) {
        links_->open(url, LinkPolicy::From::FriendPage, nobody);
    }));
    notice_->raise();
}

void ConversationWindow::showFriends() {
    pages_->open(std::make_unique<FriendsPage>(host_, [this](const std::string& handle) {
        links_->open("wayloc://friend/" + handle, LinkPolicy::From::Conversation);
    }));
    notice_->raise();
}

void ConversationWindow::showSelf() {
    SelfPage::Wish wish;
    if (live_) {
        wish = [live = std::weak_ptr(live_)](std::optional<bool> isSeen, SelfPage::Said said) {
            if (const auto conversation = live.lock()) {
                conversation->wishToBeSeen(isSeen, std::move(said));
            } else {
                said(std::nullopt);
            }
        };
    }
    pages_->open(std::make_unique<SelfPage>(host_, std::move(wish)));
    notice_->raise();
}

}  // namespace ktr::app
