#include "app/window/ConversationWindow.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QPainter>
#include <QTime>
#include <algorithm>
#include <cmath>
#include <initializer_list>
#include <utility>

#include "app/window/pages/SignInPage.h"
#include "host/conversation/WideColumns.h"
#include "platform/base/LogArea.h"

namespace ktr::app {

namespace {

constexpr int kAboveField = 10;
constexpr int kFieldToStatus = 8;
constexpr int kBelowStatus = 11;
constexpr double kMillisecondsASecond = 1000.0;
/// A lower window has no status line.
constexpr int kLowestWithStatus = 240;

}  // namespace

ConversationWindow::ConversationWindow(host::Host& host)
    : host_(host),
      conversation_(new ConversationWidget(host, this)),
      sight_(*this, [&host] { return host.live() != nullptr && host.live()->isLocked(); }),
      saidTextSize_(host.settings().said.textSize) {
    setAttribute(Qt::WA_OpaquePaintEvent);
    setLayoutDirection(host.rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
    // The least size is the window's: with one of its own the conversation would reach under the field of a low window.
    setMinimumSize(conversation_->minimumSize());
    conversation_->setMinimumSize(0, 0);
    if (host_.live() != nullptr) {
        addField();
    } else {
        setFocusProxy(conversation_);
        conversation_->setFocus();
    }
    pages_ = new PageStack(this);
    pages_->setBelow([this](bool isSeen) {
        for (QWidget* part : std::initializer_list<QWidget*>{conversation_, field_, status_}) {
            if (part != nullptr) {
                part->setVisible(isSeen && (part != status_ || !isVeryLow()));
            }
        }
        if (greeting_ != nullptr) {
            greeting_->hide();
        }
        cover(!isSeen);
        if (isSeen && live_) {
            greet(live_->status());
        }
        if (settings_ != nullptr) {
            settings_->look();
        }
    });
    notice_ = new Notice(this);
    conversation_->setPaletteChanged([this] { choosePalette(); });
    host_.setRemaking([this] { pages_->letGo(); });
    host_.setRemade([this] { remade(); });
    sight_.setChanged([this] { sightChanged(); });
    choosePalette();
}

ConversationWindow::~ConversationWindow() {
    conversation_->setPaletteChanged(nullptr);
    host_.setRemade(nullptr);
    host_.setRemaking(nullptr);
    if (links_) {
        host_.delegate().open = nullptr;
    }
    if (desktop_ != nullptr) {
        desktop_->setChanged(nullptr);
    }
    host_.conversation()->setGetStreets(nullptr);
    if (live_) {
        live_->setHandlers({});
        host_.live()->setLockChanged(nullptr);
        host_.live()->setCover(nullptr);
    }
}

void ConversationWindow::addField() {
    live_ = host::LiveConversation::make(host_);
    field_ = new AskField({host_.text("ASK_FIELD"), host_.text("ASK_SEND")}, this);
    field_->edit().setMenuTexts(menuTexts());
    field_->setAsked([this](const std::string& question) {
        if (question.size() <= host::LiveConversation::kLongestQuestion) {
            live_->ask(question);
            return;
        }
        // A part of it would be another question.
        field_->edit().setText(QString::fromStdString(question));
        say(host_.text("QUESTION_TOO_LONG"));
    });
    field_->setStopped([this] { live_->stop(); });
    field_->edit().installEventFilter(this);
    status_ = new StatusLine(this);
    status_->setHelped([this] { help(); });
    settings_ = new SettingsButton(*conversation_, this);
    settings_->setPressed([this] { showSettings(); });
    settings_->setName(QString::fromStdString(host_.text("SETTINGS")));
    // From the field to the newest answer, and on to the buttons.
    setTabOrder(&field_->edit(), conversation_);
    setTabOrder(conversation_, &field_->button());
    setTabOrder(&field_->button(), &status_->help());
    setTabOrder(&status_->help(), settings_);
    setFocusProxy(&field_->edit());
    field_->edit().setFocus();
    greeting_ = new Greeting(host_, this);
    greeting_->hide();
    greeting_->setAsked([this](const std::string& question) { live_->ask(question); });
    live_->setHandlers(handlers());
    host_.conversation()->setGetStreets(wayToStreets());
    statusTimer_.setSingleShot(true);
    host_.live()->setLockChanged([this] { sight_.look(); });
    // Ages and times of the day are others now, and what was known is old.
    timeJumps_ = std::make_unique<linux_::TimeJumps>();
    timeJumps_->setJumped([this] { host_.askAgain(); });
    connect(&statusTimer_, &QTimer::timeout, this, [this] { showStatus(); });
}

host::LiveConversation::Handlers ConversationWindow::handlers() {
    host::LiveConversation::Handlers handlers;
    handlers.asked = [this](host::TurnView& turn) {
        greetNoMore();
        field_->withdraw();
        conversation_->turnCame(turn);
    };
    handlers.answered = [this](host::TurnView& turn) { conversation_->answerCame(turn); };
    handlers.changed = [this] {
        field_->setAsking(live_->canStop());
        showStatus();
        conversation_->tellListeners();
    };
    handlers.waits = [this](host::TurnView&) {
        field_->withdraw();
        conversation_->turnsChanged();
    };
    handlers.failed = [this](const std::string& question) { field_->offer(question); };
    handlers.stopped = [this](const std::string& question) {
        conversation_->turnsChanged();
        field_->offer(question);
    };
    handlers.signIn = [this] { offerSignIn(); };
    handlers.showFriends = [this] { showFriends(); };
    handlers.open = [this](const std::string& url) {
        if (links_) {
            links_->open(url, host::LinkPolicy::From::FriendPage);
        }
    };
    return handlers;
}

AskField::Texts ConversationWindow::fieldTexts() const {
    // Where there is no room for a status line, an empty field says what it would say.
    const bool isWaiting = isVeryLow() && !field_->edit().hasFocus();
    const std::string status = isWaiting ? live_->status().words : "";
    return {status.empty() ? host_.text("ASK_FIELD") : status, host_.text("ASK_SEND"), host_.text("ASK_FIELD"),
            host_.text("ASK_STOP")};
}

QuestionEdit::MenuTexts ConversationWindow::menuTexts() const {
    const auto text = [this](const char* key) { return QString::fromStdString(host_.text(key)); };
    return {text("MENU_CUT"), text("MENU_COPY"), text("MENU_PASTE"), text("MENU_SELECT_ALL")};
}

void ConversationWindow::remade() {
    setLayoutDirection(host_.rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
    conversation_->remade();
    if (field_ != nullptr) {
        field_->setTexts(fieldTexts());
        field_->edit().setMenuTexts(menuTexts());
        field_->refreshFont();
        status_->refreshFont();
        settings_->setName(QString::fromStdString(host_.text("SETTINGS")));
        settings_->refresh();
        showStatus();
    }
    pages_->refresh();
    if (greeting_ != nullptr) {
        greeting_->refresh();
    }
    place();
}

void ConversationWindow::start(const std::vector<host::Scenario>& scenarios,
                               const std::vector<std::string>& questions) {
    conversation_->scrollToNewest();
    if (live_) {
        for (const std::string& question : questions) {
            live_->ask(question);
        }
        live_->start(scenarios);
    }
}

void ConversationWindow::greet(const host::LiveStatus& now) {
    const bool isMeant = greeting_ != nullptr && !now.wantsSignIn && !live_->isWaiting() && !pages_->isOpen() &&
                         !host_.live()->isUnusable() && !host_.isRestricted();
    if (isMeant && greeting_->isHidden()) {
        greeting_->setHour(QTime::currentTime().hour());
        greeting_->refresh();
        greeting_->show();
        place();
    }
}

void ConversationWindow::greetNoMore() {
    if (greeting_ != nullptr) {
        // Perhaps it is one of its questions that was pressed.
        greeting_->hide();
        greeting_->deleteLater();
        greeting_ = nullptr;
        if (field_->isVisible()) {
            field_->edit().setFocus();
        }
    }
}

void ConversationWindow::offerSignIn() {
    const auto account = host_.live()->configuration().account.value_or(linux_::Configuration::Account());
    auto page = std::make_unique<SignInPage>(
        host_, std::make_unique<linux_::SignIn>(host_.settings().liveConfiguration.value_or("")),
        SignInPage::Before{account.host.value_or(""), account.personId});
    page->setDone([this] { pages_->closeAll(); });
    SignInPage& opened = *page;
    pages_->closeAll();
    pages_->open(std::move(page));
    if (!linkToSignIn_.empty()) {
        opened.offerLink(QString::fromStdString(std::exchange(linkToSignIn_, "")));
    }
}

void ConversationWindow::help() {
    if (live_->status().help == host::LiveStatus::Help::TryNow) {
        live_->tryNow();
    } else {
        showCheckUp();
    }
}

void ConversationWindow::showStatus() {
    const host::LiveStatus now = live_->status();
    status_->setStatus(now);
    const char* const help = now.help == host::LiveStatus::Help::TryNow    ? "STATUS_TRY_NOW"
                             : now.help == host::LiveStatus::Help::CheckUp ? "CHECK_UP"
                                                                           : nullptr;
    const QString helpBefore = status_->help().words();
    status_->setHelp(help == nullptr ? QString() : QString::fromStdString(host_.text(help)),
                     QString::fromStdString(host_.text("CHECK_UP")));
    if (std::exchange(wantsSignIn_, now.wantsSignIn) != now.wantsSignIn) {
        if (now.wantsSignIn) {
            offerSignIn();
        } else if (dynamic_cast<SignInPage*>(pages_->current()) != nullptr) {
            // Somebody signed in another way.
            pages_->closeAll();
        }
    }
    if (!linkToSignIn_.empty() && host_.live()->isSignedIn()) {
        offerLink(std::exchange(linkToSignIn_, ""));
    }
    greet(now);
    field_->setTexts(fieldTexts());
    if (!isVeryLow() && (!status_->isPlaced() || status_->help().words() != helpBefore)) {
        place();
    }
    // A line that nobody sees is written when somebody does.
    const auto seconds = sight_.isSeen() ? live_->statusChangesIn() : std::nullopt;
    if (seconds) {
        statusTimer_.start(static_cast<int>(std::ceil(*seconds * kMillisecondsASecond)));
    } else {
        statusTimer_.stop();
    }
}

void ConversationWindow::cover(bool isCovered) {
    conversation_->setSeen(sight_.isSeen() && !isCovered);
    if (host_.live() == nullptr) {
        return;
    }
    host_.live()->setCover(!isCovered ? host::SeenRequests::IsThePages()
                                      : [this](const std::vector<std::string>& handles) {
                                            const auto* page = dynamic_cast<const FriendPage*>(pages_->current());
                                            return page != nullptr && page->asksAbout(handles);
                                        });
}

void ConversationWindow::sightChanged() {
    conversation_->setSeen(sight_.isSeen() && !pages_->isOpen());
    if (live_) {
        host_.live()->setSeen(sight_.isSeen());
        showStatus();
    }
}

void ConversationWindow::choosePalette() {
    if (field_ != nullptr) {
        field_->setColors(conversation_->colors());
        status_->setColors(conversation_->colors());
        settings_->setLook({&conversation_->colors(), false});
    }
    chooseMotion();
    if (greeting_ != nullptr) {
        greeting_->setLook({&conversation_->colors(), true});
    }
    update();
}

void ConversationWindow::chooseMotion() {
    const bool isReduced = reducedMotion_ || (desktop_ != nullptr && desktop_->values().reducedMotion.value_or(false));
    conversation_->setReducedMotion(isReduced);
    pages_->setMotion(isReduced ? host::MotionStyle::Reduced : host::MotionStyle::Full);
    pages_->setLook({&conversation_->colors(), isReduced});
    notice_->setLook({&conversation_->colors(), isReduced});
}

int ConversationWindow::fieldWidth() const {
    const bool wide = width() >= host::measures::kWideFrom;
    return static_cast<int>(wide ? host::WideColumns::of(width()).cardWidth : width() - 2.0 * host::measures::kGutter);
}

int ConversationWindow::barHeight() const {
    if (field_ == nullptr) {
        return 0;
    }
    const int status = isVeryLow() ? 0 : kFieldToStatus + status_->heightForWidth(fieldWidth());
    return kAboveField + AskField::shapeHeight() + status + kBelowStatus;
}

bool ConversationWindow::isVeryLow() const {
    return height() < kLowestWithStatus;
}

void ConversationWindow::resizeEvent(QResizeEvent*) {
    place();
    if (field_ != nullptr) {
        showStatus();
    }
}

void ConversationWindow::place() {
    const int bar = barHeight();
    conversation_->setGeometry(0, 0, width(), std::max(height() - bar, 0));
    pages_->setGeometry(rect());
    if (greeting_ != nullptr) {
        greeting_->setGeometry(conversation_->geometry());
    }
    notice_->place(pages_->isOpen() ? 0 : bar);
    if (field_ == nullptr) {
        return;
    }
    const bool wide = width() >= host::measures::kWideFrom;
    const auto columns = host::WideColumns::of(width());
    const int start = static_cast<int>(wide ? columns.cardStart : host::measures::kGutter);
    const int across = fieldWidth();
    const int x = host_.rightToLeft() ? width() - start - across : start;
    const int y = height() - bar + kAboveField;
    constexpr int kAround = AskField::kAround;
    const int fieldHeight = AskField::shapeHeight();
    field_->setGeometry(x - kAround, y - kAround, across + 2 * kAround, fieldHeight + 2 * kAround);
    status_->place({x, y + fieldHeight + kFieldToStatus, across, status_->heightForWidth(across)});
    status_->setVisible(!isVeryLow() && !conversation_->isHidden());
    field_->raise();
    settings_->place();
    settings_->raise();
    pages_->raise();
    notice_->raise();
}

void ConversationWindow::paintEvent(QPaintEvent* event) {
    QPainter painter(this);
    painter.fillRect(event->rect(), conversation_->colors().window);
}

void ConversationWindow::keyPressEvent(QKeyEvent* event) {
    // Taken here and not as shortcuts: those need a window manager that says which window is active.
    if (event->modifiers() == Qt::ControlModifier && (event->key() == Qt::Key_Q || event->key() == Qt::Key_W)) {
        close();
        return;
    }
    if (changeTextSize(*event)) {
        return;
    }
    if (event->modifiers() == Qt::ControlModifier && event->key() == Qt::Key_Comma && live_ && !pages_->isOpen()) {
        showSettings();
        return;
    }
    if (event->key() == Qt::Key_Escape && field_ != nullptr) {
        live_->stop();
        field_->edit().setFocus(Qt::ShortcutFocusReason);
        return;
    }
    QWidget::keyPressEvent(event);
}

void ConversationWindow::follow(linux_::DesktopSettings& desktop, bool reducedMotion) {
    desktop_ = &desktop;
    reducedMotion_ = reducedMotion;
    desktop.setChanged([this] { desktopChanged(); });
    connect(qApp, &QGuiApplication::applicationStateChanged, this, [this](Qt::ApplicationState state) {
        if (state == Qt::ApplicationActive) {
            desktop_->refresh();
        }
    });
    desktopChanged();
}

void ConversationWindow::desktopChanged() {
    const auto& values = desktop_->values();
    chooseMotion();
    conversation_->setDesktopDark(values.dark);
    conversation_->setHighContrast(values.highContrast.value_or(false));
    conversation_->setAccent(values.accent);
    decideTextSize();
}

void ConversationWindow::decideTextSize() {
    host::HostSettings settings = host_.settings();
    settings.said.textSize = chosenTextSize_ ? chosenTextSize_ : saidTextSize_;
    settings.desktopTextScale = desktop_ != nullptr ? desktop_->values().textScale : std::nullopt;
    settings.decideTextSize();
    if (settings.textSize == host_.settings().textSize) {
        return;
    }
    if (const auto failure = host_.remake(settings)) {
        platform::areaLog(platform::LogArea::Host)
            .write(platform::LogLevel::Error, "the text size stays as it is: %@",
                   platform::FormatArgument(failure->line).shown());
    }
}

bool ConversationWindow::changeTextSize(const QKeyEvent& key) {
    using platform::ContentSizeCategory;
    // On some keyboards the plus is above another sign, or on the number pad.
    if ((key.modifiers() & ~(Qt::ShiftModifier | Qt::KeypadModifier)) != Qt::ControlModifier) {
        return false;
    }
    const auto now = static_cast<int>(host_.settings().textSize);
    const auto step = [now](int by) {
        return static_cast<ContentSizeCategory>(std::clamp(now + by, 0, static_cast<int>(ContentSizeCategory::AX5)));
    };
    switch (key.key()) {
        case Qt::Key_Plus:
        case Qt::Key_Equal:
            chosenTextSize_ = step(1);
            break;
        case Qt::Key_Minus:
            chosenTextSize_ = step(-1);
            break;
        case Qt::Key_0:
            chosenTextSize_.reset();
            break;
        default:
            return false;
    }
    decideTextSize();
    return true;
}

bool ConversationWindow::eventFilter(QObject* object, QEvent* event) {
    if (event->type() == QEvent::FocusIn || event->type() == QEvent::FocusOut) {
        // After it has the focus, or has it no more.
        QMetaObject::invokeMethod(
            this, [this] { field_->setTexts(fieldTexts()); }, Qt::QueuedConnection);
    }
    if (event->type() == QEvent::KeyPress) {
        // Keys that mean nothing in a field of one line scroll the conversation.
        auto* key = static_cast<QKeyEvent*>(event);
        if (field_->recall(*key)) {
            return true;
        }
        switch (key->key()) {
            case Qt::Key_Up:
            case Qt::Key_Down:
            case Qt::Key_PageUp:
            case Qt::Key_PageDown:
                conversation_->scrollBy(*key);
                return true;
            default:
                break;
        }
    }
    return QWidget::eventFilter(object, event);
}

}  // namespace ktr::app
