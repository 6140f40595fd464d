#pragma once

#include <functional>
#include <string>

#include "app/window/blocks/ListCard.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"

namespace ktr::app {

/// The list of the friends who were asked about, and oneself. Main thread.
class FriendsPage : public ColumnPage {
  public:
    /// Opens a friend's page, or with an empty handle one's own.
    using Open = std::function<void(const std::string& handle)>;

    FriendsPage(host::Host& host, Open open);

    QString name() const override;

  protected:
    void refreshed() override;

  private:
    void fill();

    host::Host& host_;
    const Open open_;
    Words* nobody_;
    ListCard* friends_;
    ListCard* self_;
};

}  // namespace ktr::app
