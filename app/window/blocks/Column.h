#pragma once

#include <vector>

#include "app/window/blocks/Block.h"
#include "host/conversation/CardShadow.h"

namespace ktr::app {

/// Blocks below each other, in one column in the middle of what is wider. Main thread.
class Column : public Block {
  public:
    struct Place {
        int above = 0;
        int start = 12;  ///< from the column's edges
        int end = 12;
        bool isFilled = true;    ///< as wide as the column, else as wide as it wants
        bool isCentred = false;  ///< of what is not as wide
    };

    explicit Column(QWidget* parent = nullptr) : Block(parent) {}

    /// Takes it over. It stands where the ones before it end; a hidden one takes no room.
    void add(Block* block, Place place);
    /// From here on at the lower edge, where there is room: else right below.
    void beginBottom(int below);
    void setMostWidth(int width);
    /// Above the first, below the last.
    void setMargins(int top, int bottom);
    /// Changes how far a block is from the one above.
    void setAbove(const Block* block, int above);

    int shapeHeight(int width) const override;
    /// What is painted under its cards.
    const host::CardShadow& shadow() const { return shadow_; }

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;

  private:
    struct Item {
        Block* block;
        Place place;
    };
    int columnWidth(int width) const;
    int widthOf(const Item& item, int column) const;
    void place();

    std::vector<Item> items_;
    std::size_t bottomFrom_ = static_cast<std::size_t>(-1);
    int mostWidth_ = 0;
    int top_ = 0;
    int bottom_ = 0;
    host::CardShadow shadow_;
};

}  // namespace ktr::app
