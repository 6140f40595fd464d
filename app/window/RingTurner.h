#pragma once

#include <QElapsedTimer>
#include <QTimer>
#include <functional>
#include <memory>

#include "host/conversation/ConversationView.h"

namespace ktr::app {

/// Turns the rings of the cards that search, and takes them away when their search is over. Main thread.
class RingTurner {
  public:
    /// `isStill`: whether rings stand, asked at each step.
    RingTurner(std::shared_ptr<host::ConversationView> conversation, std::function<bool()> isStill);

    /// Brings every ring up to date, and goes on by itself while one is shown.
    void update();

  private:
    std::shared_ptr<host::ConversationView> conversation_;
    std::function<bool()> isStill_;
    QTimer timer_;
    QElapsedTimer clock_;
};

}  // namespace ktr::app
