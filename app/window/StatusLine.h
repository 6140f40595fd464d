#pragma once

#include <QLabel>
#include <QWidget>

#include "host/live/LiveStatus.h"
#include "linux/paint/Palette.h"

namespace ktr::app {

/// One line: a mark and words. Main thread.
class StatusLine : public QWidget {
  public:
    /// From the line's start edge: the mark's centre and the words.
    static constexpr int kMarkCentre = 19;
    static constexpr int kWords = 33;

    explicit StatusLine(QWidget* parent = nullptr);

    void setStatus(const host::LiveStatus& status);
    void setColors(const linux_::Palette& palette);
    QString words() const { return words_->text(); }
    /// Where the text size has become another.
    void refreshFont();
    /// Large words take as many lines as they need.
    int heightForWidth(int width) const override;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

  private:
    QLabel* words_;
    const linux_::Palette* palette_;
    host::LiveStatus::Mark mark_ = host::LiveStatus::Mark::None;
    int lineHeight_ = 0;
};

}  // namespace ktr::app
