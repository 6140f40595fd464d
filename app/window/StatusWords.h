#pragma once

#include <QLabel>
#include <memory>

#include "linux/paint/Palette.h"
#include "linux/paint/QtTextLayout.h"

namespace ktr::app {

/// The words of the status line, set as the conversation's texts are. They change every few seconds: assistive
/// technology reads them when it asks, and never gets a notice of a change. Main thread.
class StatusWords : public QLabel {
  public:
    explicit StatusWords(QWidget* parent);

    void setColors(const linux_::Palette& palette);
    /// Of as many lines as the words take at this width; 0 without words.
    int heightForWidth(int width) const override;

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    /// None without an installed platform.
    std::shared_ptr<const linux_::QtTextLayout> layOut(int width) const;

    const linux_::Palette* palette_;
};

}  // namespace ktr::app
