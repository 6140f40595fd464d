#pragma once

#include <QElapsedTimer>
#include <QTimer>
#include <functional>
#include <memory>

#include "host/conversation/ConversationView.h"

namespace ktr::app {

/// Turns the rings of the cards that search, and takes them away when their search is over, and those of questions that
/// wait; of turns that are seen. Main thread.
class RingTurner {
  public:
    /// Both are asked at each step. `isStill`: whether rings stand; `isSeen`: whether anybody sees this turn.
    RingTurner(std::shared_ptr<host::ConversationView> conversation, std::function<bool()> isStill,
               std::function<bool(const host::TurnView&)> isSeen);

    /// Brings every ring up to date, and goes on by itself while one is seen: whoever brings another turn on screen
    /// calls again.
    void update();

  private:
    std::shared_ptr<host::ConversationView> conversation_;
    std::function<bool()> isStill_;
    std::function<bool(const host::TurnView&)> isSeen_;
    QTimer timer_;
    QElapsedTimer clock_;
};

}  // namespace ktr::app
