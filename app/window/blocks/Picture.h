#pragma once

#include <memory>

#include "app/window/blocks/Block.h"
#include "linux/paint/QtImage.h"

namespace ktr::app {

/// A square picture of a page, such as the program's icon; only looked at. Main thread.
class Picture : public Block {
  public:
    explicit Picture(int side, QWidget* parent = nullptr) : Block(parent), side_(side) {}

    /// None shows nothing, in the same room.
    void setImage(std::shared_ptr<const linux_::QtImage> image);

    int shapeHeight(int /*width*/) const override { return side_; }
    int naturalWidth() const override { return side_; }
    /// It says nothing that the words beside it do not.
    QAccessible::Role role() const override { return QAccessible::Whitespace; }

  protected:
    void paintEvent(QPaintEvent* event) override;

  private:
    const int side_;
    std::shared_ptr<const linux_::QtImage> image_;
};

}  // namespace ktr::app
