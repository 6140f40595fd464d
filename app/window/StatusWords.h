#pragma once

#include <QLabel>

namespace ktr::app {

/// The words of the status line. They change every few seconds: assistive technology reads them when it asks, and is
/// never told of a change. Main thread.
class StatusWords : public QLabel {
  public:
    explicit StatusWords(QWidget* parent);
};

}  // namespace ktr::app
