#pragma once

#include <vector>

#include "app/window/blocks/IconButton.h"

namespace ktr::app {

/// Buttons on a map, below each other in one round body. Main thread.
class MapControls : public Block {
  public:
    explicit MapControls(QWidget* parent = nullptr) : Block(parent) {}

    IconButton& add(Icon icon, IconButton::Tone tone);
    int shapeHeight(int width) const override;
    int naturalWidth() const override { return IconButton::side(); }
    double corner() const { return IconButton::side() / 2.0; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void refreshed() override { askForRoom(); }

  private:
    std::vector<IconButton*> buttons_;
};

}  // namespace ktr::app
