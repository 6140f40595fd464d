#pragma once

#include <functional>
#include <memory>
#include <optional>

#include "app/window/blocks/ListRow.h"
#include "host/Host.h"
#include "host/live/LiveConversation.h"

namespace ktr::app {

/// The switch for whether friends can see the user, as the service says it is. A wish that fails turns it back, with
/// why. Main thread.
class SharingRow : public ListRow {
  public:
    using Sharing = host::LiveConversation::Sharing;
    using Said = std::function<void(const Sharing&)>;
    /// Says a wish to the service, or asks with none how it is; what it says comes once. Empty: nothing is live.
    using Wish = std::function<void(std::optional<bool> isSeen, Said said)>;

    SharingRow(host::Host& host, Wish wish);

    /// Asks how it is.
    void ask() { say(std::nullopt); }
    /// Whether the service has said so.
    bool isKnown() const { return isSeen_.has_value(); }
    /// Called after the service has said something, or has not.
    void setHeard(std::function<void()> heard) { heard_ = std::move(heard); }

  protected:
    void refreshed() override;

  private:
    void say(std::optional<bool> wish);
    void hear(const Sharing& sharing);
    const char* secondKey() const;
    void setTexts();

    host::Host& host_;
    const Wish wish_;
    std::function<void()> heard_;
    /// As the service said last; none before.
    std::optional<bool> isSeen_;
    /// Of the last that was said or asked.
    ask::ServiceReply::Failure failure_ = ask::ServiceReply::Failure::None;
    bool isAsking_ = false;
    /// For answers that come when the row has gone.
    std::shared_ptr<SharingRow*> self_ = std::make_shared<SharingRow*>(this);
};

}  // namespace ktr::app
