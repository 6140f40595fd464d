#pragma once

#include <QTimer>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "app/window/AskField.h"
#include "app/window/CaretRest.h"
#include "app/window/ConversationWidget.h"
#include "app/window/Greeting.h"
#include "app/window/LinkOpener.h"
#include "app/window/Notice.h"
#include "app/window/PlainWidget.h"
#include "app/window/SettingsButton.h"
#include "app/window/StatusLine.h"
#include "app/window/WindowSight.h"
#include "app/window/friend/SharingRow.h"
#include "app/window/pages/PageStack.h"
#include "host/live/LiveConversation.h"
#include "linux/device/DesktopSettings.h"
#include "linux/device/TimeJumps.h"

namespace ktr::app {

/// The window: a conversation and, where it is live, the field and the status line under it. Main thread.
class ConversationWindow : public PlainWidget {
  public:
    /// The host outlives the window.
    explicit ConversationWindow(host::Host& host);
    ~ConversationWindow() override;

    /// Motion, contrast and text size are the desktop's from now on, where nothing else says more; it outlives the
    /// window. With `reducedMotion` nothing moves whatever the desktop says.
    void follow(linux_::DesktopSettings& desktop, bool reducedMotion);
    /// Where the window is live: shows the scenarios and asks the questions once the account is read.
    void start(const std::vector<host::Scenario>& scenarios, const std::vector<std::string>& questions);

    /// Links lead to pages of this window from now on, or to the desktop, whose opener outlives the window.
    void openLinks(linux_::DesktopOpener& desktop);
    /// A link that somebody sent; nothing before `openLinks`.
    void open(const std::string& url, host::LinkPolicy::From from);
    Notice& notice() const { return *notice_; }

    ConversationWidget& conversation() const { return *conversation_; }
    /// None where nothing is live.
    AskField* field() const { return field_; }
    StatusLine* status() const { return status_; }
    /// Opens the settings; none where nothing is live.
    SettingsButton* settings() const { return settings_; }
    /// What covers the conversation: settings, a friend, signing in.
    PageStack& pages() const { return *pages_; }

  protected:
    void resizeEvent(QResizeEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    void addField();
    void offerLink(const std::string& link);
    host::LiveConversation::Handlers handlers();
    void showFriend(const host::KnownFriends::Known& known, FriendPage::Asks asks);
    void showSelf();
    SharingRow::Wish sharingWish() const;
    void showFriends();
    void say(const std::string& sentence);
    void choosePalette();
    void chooseMotion();
    /// Shows the greeting while nothing was asked in this window.
    void greet(const host::LiveStatus& now);
    void greetNoMore();
    /// Asks for the account where that is missing.
    void offerSignIn();
    void showStatus();
    /// What the status line's button promises.
    void help();
    enum class SettingsFrom { Top, Maps };
    /// Leads to where a map is added; empty where nothing is live, as there are no settings.
    std::function<void()> wayToStreets();
    void showSettings(SettingsFrom from = SettingsFrom::Top);
    void showCheckUp();
    /// Whether anybody sees the window has become another.
    void sightChanged();
    /// Tells the cards, and what shows of them, whether a page covers them.
    void cover(bool isCovered);
    void remade();
    /// Puts conversation, field and status line where they belong.
    void place();
    AskField::Texts fieldTexts() const;
    QuestionEdit::MenuTexts menuTexts() const;
    bool isVeryLow() const;
    int barHeight() const;
    int fieldWidth() const;
    void desktopChanged();
    /// One size larger, one smaller, or with none back to what it is without the window's user.
    bool changeTextSize(const QKeyEvent& key);
    void decideTextSize();

    host::Host& host_;
    ConversationWidget* conversation_;
    std::shared_ptr<host::LiveConversation> live_;
    AskField* field_ = nullptr;
    StatusLine* status_ = nullptr;
    PageStack* pages_;
    SettingsButton* settings_ = nullptr;  ///< none where nothing is live
    /// None where nothing is live, and once something was asked.
    Greeting* greeting_ = nullptr;
    Notice* notice_;
    std::unique_ptr<LinkOpener> links_;
    QTimer statusTimer_;
    /// What the status said last: a page that was answered is not shown again before the answer counts.
    bool wantsSignIn_ = false;
    /// That somebody sent before it was known whether anybody is signed in.
    std::string linkToSignIn_;
    std::unique_ptr<linux_::TimeJumps> timeJumps_;  ///< none where nothing is live
    WindowSight sight_;
    CaretRest caretRest_;
    linux_::DesktopSettings* desktop_ = nullptr;
    bool reducedMotion_ = false;
    /// What options and scenarios said of the text size, and what the window's user has chosen since.
    const std::optional<platform::ContentSizeCategory> saidTextSize_;
    std::optional<platform::ContentSizeCategory> chosenTextSize_;
};

}  // namespace ktr::app
