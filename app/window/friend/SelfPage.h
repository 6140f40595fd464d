#pragma once

#include <functional>
#include <memory>
#include <optional>

#include "app/window/blocks/ListRow.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"

namespace ktr::app {

/// One's own page: whether friends can see the user, and the switch for it. Main thread.
class SelfPage : public ColumnPage {
  public:
    using Said = std::function<void(std::optional<bool> isSeen)>;
    /// Says a wish to the service, or asks with none how it is; what it says comes once, none where it says nothing.
    /// Empty: nothing is live.
    using Wish = std::function<void(std::optional<bool> isSeen, Said said)>;

    SelfPage(host::Host& host, Wish wish);

    QString name() const override;
    QWidget* firstFocus() const override { return switch_; }
    ListRow& sharing() const { return *switch_; }

  protected:
    void refreshed() override;

  private:
    void say(std::optional<bool> wish);
    void heard(std::optional<bool> isSeen, bool wasWish);
    void setTexts();

    host::Host& host_;
    const Wish wish_;
    ListRow* switch_;
    /// As the service said last; none before.
    std::optional<bool> isSeen_;
    bool hasFailed_ = false;
    bool isAsking_ = false;
    bool hasAsked_ = false;
    /// For answers that come when the page has gone.
    std::shared_ptr<SelfPage*> self_ = std::make_shared<SelfPage*>(this);
};

}  // namespace ktr::app
