#pragma once

#include <functional>

#include "app/window/blocks/Button.h"
#include "app/window/blocks/ListCard.h"
#include "app/window/pages/ColumnPage.h"
#include "host/Host.h"

namespace ktr::app {

/// A map of one's own, and the button that takes it away. Main thread.
class MapPage : public ColumnPage {
  public:
    MapPage(host::Host& host, QString map, const QString& second, std::function<void()> remove);

    QString name() const override { return map_; }
    QWidget* firstFocus() const override { return remove_; }
    Button& remove() const { return *remove_; }

  protected:
    void refreshed() override;

  private:
    host::Host& host_;
    const QString map_;
    Button* remove_;
};

}  // namespace ktr::app
