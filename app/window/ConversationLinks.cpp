// Where links lead from a conversation's window.
#include "app/DoctorCommand.h"
#include "app/window/ConversationWindow.h"
#include "app/window/checkup/CheckUpPage.h"
#include "app/window/friend/FriendsPage.h"
#include "app/window/friend/SelfPage.h"
#include "app/window/pages/SignInPage.h"
#include "app/window/settings/SettingsPage.h"
#include "linux/configuration/SignInLink.h"

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
    if (live_ && linux_::SignInLink::read(url)) {
        offerLink(url);
    } else if (links_) {
        links_->open(url, from);
    }
}

void ConversationWindow::offerLink(const std::string& link) {
    if (auto* page = dynamic_cast<SignInPage*>(pages_->current())) {
        page->offerLink(QString::fromStdString(link));
    } else if (host_.live()->isSignedIn()) {
        // Nobody is signed out, or in as somebody else, by a link that came from elsewhere.
        say(host_.text("SIGN_IN_ALREADY"));
    } else {
        linkToSignIn_ = link;
    }
}

void ConversationWindow::say(const std::string& sentence) {
    notice_->place(pages_->isOpen() ? 0 : barHeight());
    notice_->say(QString::fromStdString(sentence));
}

void ConversationWindow::showFriend(const host::KnownFriends::Known& known, FriendPage::Asks asks) {
    const auto open = [this](const std::string& url, const char* nobody) {
        links_->open(url, LinkPolicy::From::FriendPage, nobody);
    };
    pages_->open(std::make_unique<FriendPage>(host_, known, asks, open, wayToStreets()));
    notice_->raise();
}

std::function<void()> ConversationWindow::wayToStreets() {
    if (!live_) {
        return nullptr;
    }
    return [this] { showSettings(SettingsFrom::Maps); };
}

void ConversationWindow::showFriends() {
    using Live = host::LiveConversation;
    std::optional<FriendsPage::Sharing> sharing;
    if (live_) {
        sharing =
            FriendsPage::Sharing{[live = live_](auto told) { live->whoShares(std::move(told)); },
                                 [this](const Live::Sharer& sharer) {
                                     const auto known = host::KnownFriends::fromContacts(sharer.handle);
                                     showFriend(known.value_or(host::KnownFriends::named(sharer.name, sharer.handle)),
                                                FriendPage::Asks::AtOnce);
                                 }};
    }
    pages_->open(std::make_unique<FriendsPage>(
        host_,
        [this](const std::string& handle) {
            links_->open("wayloc://friend/" + handle, LinkPolicy::From::Conversation);
        },
        std::move(sharing)));
    notice_->raise();
}

SharingRow::Wish ConversationWindow::sharingWish() const {
    if (!live_) {
        return {};
    }
    return [live = live_](std::optional<bool> isSeen, SharingRow::Said said) {
        live->wishToBeSeen(isSeen, std::move(said));
    };
}

void ConversationWindow::showSettings(SettingsFrom from) {
    SettingsPage::Window window;
    window.beginsAtMaps = from == SettingsFrom::Maps;
    window.open = [this](std::unique_ptr<Page> page) {
        pages_->open(std::move(page));
        notice_->raise();
    };
    window.back = [this] { pages_->back(); };
    window.showCheckUp = [this] { showCheckUp(); };
    window.openLink = [this](const std::string& url) {
        if (links_) {
            links_->open(url, LinkPolicy::From::Conversation);
        }
    };
    window.say = [this](const std::string& sentence) { say(sentence); };
    window.setTextSize = [this](platform::ContentSizeCategory size) {
        chosenTextSize_ = size;
        decideTextSize();
    };
    window.isTextSizeHeld = saidTextSize_.has_value();
    auto page = std::make_unique<SettingsPage>(host_, sharingWish(), std::move(window));
    SettingsPage& opened = *page;
    pages_->open(std::move(page));
    if (from == SettingsFrom::Maps) {
        opened.reveal(opened.maps());
    }
    notice_->raise();
}

void ConversationWindow::showCheckUp() {
    auto places = DoctorCommand::places();
    places.configuration = host_.settings().liveConfiguration.value_or(places.configuration);
    pages_->open(
        std::make_unique<CheckUpPage>(host_, std::move(places),
                                      CheckUpPage::Window{[this] { offerSignIn(); }, [this] { showSettings(); },
                                                          [this] { host_.live()->readAgain(); }}));
    notice_->raise();
}

void ConversationWindow::showSelf() {
    pages_->open(std::make_unique<SelfPage>(host_, sharingWish()));
    notice_->raise();
}

}  // namespace ktr::app
