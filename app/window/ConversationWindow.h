#pragma once

#include <QTimer>
#include <QWidget>
#include <memory>
#include <string>
#include <vector>

#include "app/window/AskField.h"
#include "app/window/ConversationWidget.h"
#include "app/window/StatusLine.h"
#include "host/live/LiveConversation.h"

namespace ktr::app {

/// The window: a conversation and, where it is live, the field and the status line under it. Main thread.
class ConversationWindow : public QWidget {
  public:
    /// The host outlives the window.
    explicit ConversationWindow(host::Host& host);
    ~ConversationWindow() override;

    void setReducedMotion(bool reduced) { conversation_->setReducedMotion(reduced); }
    /// Where the window is live: shows the scenarios and asks the questions once the account is read.
    void start(const std::vector<host::Scenario>& scenarios, const std::vector<std::string>& questions);

    ConversationWidget& conversation() const { return *conversation_; }
    /// None where nothing is live.
    AskField* field() const { return field_; }
    StatusLine* status() const { return status_; }

  protected:
    void resizeEvent(QResizeEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    bool eventFilter(QObject* object, QEvent* event) override;

  private:
    void addField();
    void choosePalette();
    void showStatus();
    void remade();
    /// Puts conversation, field and status line where they belong.
    void place();
    AskField::Texts fieldTexts() const;
    int barHeight() const;

    host::Host& host_;
    ConversationWidget* conversation_;
    std::shared_ptr<host::LiveConversation> live_;
    AskField* field_ = nullptr;
    StatusLine* status_ = nullptr;
    QTimer statusTimer_;
};

}  // namespace ktr::app
