#pragma once

#include <QScrollArea>

namespace ktr::app {

/// What a page scrolls in. Assistive technology finds the page in it, and none of the toolkit's own helpers, which say
/// that they can be pressed. Main thread.
class PageArea : public QScrollArea {
  public:
    explicit PageArea(QWidget* parent);
};

}  // namespace ktr::app
