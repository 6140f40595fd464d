#pragma once

#include <QScrollBar>

namespace ktr::app {

/// The scroll bar over a page: for mouse and finger. Keys scroll by moving the focus, so assistive technology finds
/// nothing to press in it. Main thread.
class PageHandle : public QScrollBar {
  public:
    explicit PageHandle(QWidget* parent);
};

}  // namespace ktr::app
