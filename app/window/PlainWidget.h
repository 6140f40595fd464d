#pragma once

#include <QWidget>

namespace ktr::app {

/// A widget that only holds others: assistive technology finds nothing to press in it. Main thread.
class PlainWidget : public QWidget {
  public:
    explicit PlainWidget(QWidget* parent = nullptr);
};

}  // namespace ktr::app
