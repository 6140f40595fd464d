#pragma once

#include <QElapsedTimer>
#include <QTimer>

#include "app/window/blocks/BlockText.h"
#include "app/window/blocks/Icon.h"
#include "app/window/blocks/PressBlock.h"

namespace ktr::app {

/// A button with words. Main thread.
class Button : public PressBlock {
  public:
    enum class Kind {
        Main,   ///< at most one on a screen
        Quiet,  ///< everything else
        Text,   ///< without an edge, beside something larger
        Line,   ///< the same in a line of footnote
    };

    explicit Button(Kind kind, const QString& words = {}, Icon icon = Icon::None, QWidget* parent = nullptr);

    void setWords(const QString& words);
    const QString& words() const { return words_.text(); }
    void setIcon(Icon icon);
    /// It takes something away: its words are not in the colour of what can be done.
    void setTakesAway(bool takesAway);
    /// Turns a ring before the words; it cannot be pressed then. `words` are shown meanwhile.
    void setBusy(bool isBusy);
    /// As wide as the page: higher then, where it is quiet.
    void setWide(bool isWide);

    int shapeHeight(int width) const override;
    int naturalWidth() const override;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void lookChanged() override;
    void refreshed() override { askForRoom(); }

  private:
    int padding() const;
    int iconRoom() const;
    QColor inkNow() const;
    void paintGround(QPainter& painter, const QRectF& shape, double corner) const;

    const Kind kind_;
    BlockText words_;
    Icon icon_;
    bool takesAway_ = false;
    bool isBusy_ = false;
    bool isWide_ = false;
    QTimer timer_;
    QElapsedTimer clock_;
};

}  // namespace ktr::app
