#pragma once

#include <functional>

#include "app/window/PlainWidget.h"
#include "app/window/StatusWords.h"
#include "app/window/blocks/Button.h"
#include "host/live/LiveStatus.h"
#include "linux/paint/Palette.h"

namespace ktr::app {

/// A mark and words, which take as many lines as they need. Main thread.
class StatusLine : public PlainWidget {
  public:
    /// From the line's start edge: the mark's centre and the words.
    static constexpr int kMarkCentre = 19;
    static constexpr int kWords = 33;

    explicit StatusLine(QWidget* parent = nullptr);

    void setStatus(const host::LiveStatus& status);
    /// What mends it stands at its end, a button of the parent's, since it is higher than a line. Empty: nothing;
    /// listeners meet the button all the same, and hear that it is called `otherwise`.
    void setHelp(const QString& words, const QString& otherwise);
    void setHelped(std::function<void()> helped) { help_->setPressed(std::move(helped)); }
    Button& help() const { return *help_; }
    void setColors(const linux_::Palette& palette);
    QString words() const { return words_->text(); }
    /// Where the text size has become another.
    void refreshFont();
    /// Where it stands in its parent: as wide, and at least a line high. Letters that are higher or deeper than a line
    /// reach beyond it, above and below.
    void place(const QRect& lines);
    /// Of the lines alone, at least one.
    int heightForWidth(int width) const override;
    /// Whether its words take as many lines as it has.
    bool isPlaced() const;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void hideEvent(QHideEvent* event) override;

  private:
    int overhang() const { return lineHeight_ / 4; }
    /// Of the words' end from the line's.
    int helpRoom() const;
    void showHelp();

    StatusWords* words_;
    Button* help_;
    const linux_::Palette* palette_;
    host::LiveStatus::Mark mark_ = host::LiveStatus::Mark::None;
    int lineHeight_ = 0;
};

}  // namespace ktr::app
