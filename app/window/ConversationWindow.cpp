#include "app/window/ConversationWindow.h"

#include <QKeyEvent>
#include <QPainter>

#include "host/conversation/WideColumns.h"

namespace ktr::app {

namespace {

constexpr int kAboveField = 10;
constexpr int kFieldToStatus = 8;
constexpr int kBelowStatus = 11;
constexpr int kStatusEvery = 1000;  // milliseconds

}  // namespace

ConversationWindow::ConversationWindow(host::Host& host)
    : host_(host), conversation_(new ConversationWidget(host, this)) {
    setAttribute(Qt::WA_OpaquePaintEvent);
    setLayoutDirection(host.rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
    setMinimumSize(conversation_->minimumSize());
    if (host_.live() != nullptr) {
        addField();
    } else {
        setFocusProxy(conversation_);
        conversation_->setFocus();
    }
    conversation_->setPaletteChanged([this] { choosePalette(); });
    host_.setRemade([this] { remade(); });
    choosePalette();
}

ConversationWindow::~ConversationWindow() {
    conversation_->setPaletteChanged(nullptr);
    host_.setRemade(nullptr);
    if (live_) {
        live_->setHandlers({});
    }
}

void ConversationWindow::addField() {
    live_ = host::LiveConversation::make(host_);
    field_ = new AskField(fieldTexts(), this);
    field_->setAsked([this](const std::string& question) { live_->ask(question); });
    field_->edit().installEventFilter(this);
    status_ = new StatusLine(this);
    setFocusProxy(&field_->edit());
    field_->edit().setFocus();
    live_->setHandlers({[this](host::TurnView& turn) { conversation_->turnCame(turn); },
                        [this](host::TurnView& turn) { conversation_->answerCame(turn); }, [this] { showStatus(); }});
    statusTimer_.setInterval(kStatusEvery);
    connect(&statusTimer_, &QTimer::timeout, this, [this] { showStatus(); });
}

AskField::Texts ConversationWindow::fieldTexts() const {
    return {host_.text("ASK_FIELD"), host_.text("ASK_SEND")};
}

void ConversationWindow::remade() {
    setLayoutDirection(host_.rightToLeft() ? Qt::RightToLeft : Qt::LeftToRight);
    conversation_->remade();
    if (field_ != nullptr) {
        field_->setTexts(fieldTexts());
        showStatus();
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
        statusTimer_.start();
    }
}

void ConversationWindow::showStatus() {
    status_->setStatus(live_->status());
}

void ConversationWindow::choosePalette() {
    if (field_ != nullptr) {
        field_->setColors(conversation_->colors());
        status_->setColors(conversation_->colors());
    }
    update();
}

int ConversationWindow::barHeight() const {
    return field_ == nullptr ? 0
                             : kAboveField + AskField::kHeight + kFieldToStatus + status_->lineHeight() + kBelowStatus;
}

void ConversationWindow::resizeEvent(QResizeEvent*) {
    place();
}

void ConversationWindow::place() {
    const int bar = barHeight();
    conversation_->setGeometry(0, 0, width(), std::max(height() - bar, 0));
    if (field_ == nullptr) {
        return;
    }
    const bool wide = width() >= host::measures::kWideFrom;
    const auto columns = host::WideColumns::of(width());
    const int fieldWidth = static_cast<int>(wide ? columns.cardWidth : width() - 2.0 * host::measures::kGutter);
    const int start = static_cast<int>(wide ? columns.cardStart : host::measures::kGutter);
    const int x = host_.rightToLeft() ? width() - start - fieldWidth : start;
    const int y = height() - bar + kAboveField;
    constexpr int kAround = AskField::kAround;
    field_->setGeometry(x - kAround, y - kAround, fieldWidth + 2 * kAround, AskField::kHeight + 2 * kAround);
    status_->setGeometry(x, y + AskField::kHeight + kFieldToStatus, fieldWidth, status_->lineHeight());
    field_->raise();
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
    QWidget::keyPressEvent(event);
}

bool ConversationWindow::eventFilter(QObject* object, QEvent* event) {
    if (event->type() == QEvent::KeyPress) {
        // Keys that mean nothing in a field of one line scroll the conversation.
        auto* key = static_cast<QKeyEvent*>(event);
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
