#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/window/blocks/ListCard.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"
#include "host/links/KnownFriends.h"
#include "host/live/LiveConversation.h"

namespace ktr::app {

/// The list of the friends who were asked about, of those who share with the user, and oneself. Main thread.
class FriendsPage : public ColumnPage {
  public:
    /// Opens a friend's page, or with an empty handle one's own.
    using Open = std::function<void(const std::string& handle)>;
    using Sharers = std::vector<host::LiveConversation::Sharer>;
    /// Those who share: the service's answer, and whom one of them leads to.
    struct Sharing {
        std::function<void(std::function<void(const Sharers&)> told)> ask;
        std::function<void(const host::LiveConversation::Sharer&)> open;
    };

    /// Without `sharing` nothing is live.
    FriendsPage(host::Host& host, Open open, std::optional<Sharing> sharing = std::nullopt);

    QString name() const override;

  protected:
    void refreshed() override;

  private:
    void fill();
    void fillSharers(const std::vector<host::KnownFriends::Known>& known);
    ListRow* rowOf(const platform::VAKtrLocation& location) const;

    host::Host& host_;
    const Open open_;
    const std::optional<Sharing> sharing_;
    Sharers told_;
    Words* nobody_;
    ListCard* friends_;
    Words* sharersName_;
    ListCard* sharers_;
    ListCard* self_;
    bool hasAsked_ = false;
    /// For answers that come when the page has gone.
    std::shared_ptr<FriendsPage*> here_ = std::make_shared<FriendsPage*>(this);
};

}  // namespace ktr::app
