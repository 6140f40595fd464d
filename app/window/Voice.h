#pragma once

#include <memory>
#include <vector>

#include "host/Host.h"
#include "host/heard/Announcements.h"

namespace ktr::app {

class Announcer;
class ConversationWidget;

/// Tells who listens what happens in a conversation. Main thread.
class Voice {
  public:
    /// The host outlives it; the widget owns it.
    Voice(host::Host& host, const ConversationWidget& widget);
    ~Voice();

    /// Something may have changed: the rows, or how the service is.
    void changed() { announcements_.changed(); }
    /// A turn got its answer, which is laid out.
    void answerCame(const host::TurnView& turn);

  private:
    host::Announcements::State look() const;

    host::Host& host_;
    const ConversationWidget& widget_;
    std::unique_ptr<Announcer> announcer_;
    host::Announcements announcements_;
};

}  // namespace ktr::app
