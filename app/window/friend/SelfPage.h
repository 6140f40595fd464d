#pragma once

#include "app/window/friend/SharingRow.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"

namespace ktr::app {

/// One's own page: whether friends can see the user, and the switch for it. Main thread.
class SelfPage : public ColumnPage {
  public:
    SelfPage(host::Host& host, SharingRow::Wish wish);

    QString name() const override;
    QWidget* firstFocus() const override { return switch_; }
    ListRow& sharing() const { return *switch_; }

  protected:
    void refreshed() override;

  private:
    host::Host& host_;
    SharingRow* switch_;
    bool hasAsked_ = false;
};

}  // namespace ktr::app
