#pragma once

#include <vector>

#include "app/window/blocks/Block.h"
#include "app/window/blocks/ListRow.h"

namespace ktr::app {

/// A card of rows with hairlines between them. The rows are its children; what else is added stands among them. Main
/// thread.
class ListCard : public Block {
  public:
    explicit ListCard(QWidget* parent = nullptr);

    /// Takes it over.
    void add(Block* row);
    const std::vector<Block*>& rows() const { return rows_; }
    /// Deletes all rows.
    void clear();
    /// Without hairlines.
    void setParted(bool isParted) { isParted_ = isParted; }

    int shapeHeight(int width) const override;
    void paintUnder(QPainter& painter, const QRectF& shape, host::CardShadow& shadow) const override;

  protected:
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    bool event(QEvent* event) override;

  private:
    void place();

    std::vector<Block*> rows_;
    bool isParted_ = true;
};

}  // namespace ktr::app
