#pragma once

#include <vector>

#include "app/window/blocks/Block.h"

namespace ktr::app {

/// Buttons or pills side by side where they fit, else below each other with their start edges aligned. Main thread.
class Flow : public Block {
  public:
    explicit Flow(int gap = 8, QWidget* parent = nullptr) : Block(parent), gap_(gap) {}

    /// Takes it over.
    void add(Block* block);
    void clear();
    const std::vector<Block*>& blocks() const { return blocks_; }
    /// Below each other, at the end: as unasked questions stand.
    void setAtEnd(bool isAtEnd) { isAtEnd_ = isAtEnd; }
    /// Side by side they share the width.
    void setFilling(bool isFilling) { isFilling_ = isFilling; }

    /// Room for the rings of what stands at its edges.
    int around() const override { return kAround; }
    int shapeHeight(int width) const override;

  protected:
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;

  private:
    static constexpr int kAround = 6;

    std::vector<QRect> plan(int width) const;
    std::vector<Block*> seen() const;
    void place();

    const int gap_;
    std::vector<Block*> blocks_;
    bool isAtEnd_ = false;
    bool isFilling_ = false;
};

}  // namespace ktr::app
