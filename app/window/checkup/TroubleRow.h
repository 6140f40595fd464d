#pragma once

#include "app/window/blocks/Block.h"
#include "app/window/blocks/BlockText.h"
#include "app/window/blocks/Button.h"

namespace ktr::app {

/// What is wrong, what that does to the user, and the one button that mends it. Main thread.
class TroubleRow : public Block {
  public:
    TroubleRow(const QString& title, const QString& cause, const QString& mends, QWidget* parent = nullptr);

    Button& button() const { return *button_; }

    int shapeHeight(int width) const override;
    QAccessible::Role role() const override { return QAccessible::StaticText; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void refreshed() override;

  private:
    double start() const;
    double markSide() const;
    int across(int width) const;
    int textHeight(int width) const;
    void place();

    BlockText title_, cause_;
    Button* button_;
};

}  // namespace ktr::app
