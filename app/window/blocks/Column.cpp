#include "app/window/blocks/Column.h"

#include <QEvent>
#include <QPainter>
#include <algorithm>
#include <utility>

namespace ktr::app {

void Column::add(Block* block, Place place) {
    block->setParent(this);
    block->setLook(look());
    block->show();
    items_.push_back({block, place});
    askForRoom();
}

void Column::beginBottom(int below) {
    bottomFrom_ = items_.size();
    bottom_ = below;
}

void Column::setMostWidth(int width) {
    // Whoever lays a page out says it each time: only news may ask for another layout.
    if (std::exchange(mostWidth_, width) != width) {
        askForRoom();
    }
}

void Column::setMargins(int top, int bottom) {
    top_ = top;
    bottom_ = bottom;
    askForRoom();
}

void Column::setAbove(const Block* block, int above) {
    for (Item& item : items_) {
        if (item.block == block && std::exchange(item.place.above, above) != above) {
            askForRoom();
        }
    }
}

int Column::columnWidth(int width) const {
    return mostWidth_ > 0 ? std::min(mostWidth_, width) : width;
}

int Column::widthOf(const Item& item, int column) const {
    const int room = std::max(column - item.place.start - item.place.end, 1);
    return item.place.isFilled ? room : std::min(room, item.block->naturalWidth());
}

int Column::shapeHeight(int width) const {
    const int column = columnWidth(width);
    int height = top_ + bottom_;
    for (const Item& item : items_) {
        if (!item.block->isHidden()) {
            height += item.place.above + item.block->shapeHeight(widthOf(item, column));
        }
    }
    return height;
}

void Column::place() {
    const int column = columnWidth(width());
    const int left = (width() - column) / 2;
    const int spare = std::max(height() - shapeHeight(width()), 0);
    int y = top_;
    for (std::size_t i = 0; i < items_.size(); ++i) {
        const Item& item = items_[i];
        if (i == bottomFrom_) {
            y += spare;
        }
        if (item.block->isHidden()) {
            continue;
        }
        const int across = widthOf(item, column);
        const int high = item.block->shapeHeight(across);
        y += item.place.above;
        const int x = item.place.isCentred ? left + (column - across) / 2 : left + item.place.start;
        item.block->placeShape(mirrored(QRectF(x, y, across, high)).toRect());
        y += high;
    }
    update();
}

void Column::resizeEvent(QResizeEvent*) {
    place();
}

bool Column::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        askForRoom();
        return true;
    }
    return Block::event(event);
}

void Column::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    for (const Item& item : items_) {
        if (!item.block->isHidden()) {
            const int around = item.block->around();
            item.block->paintUnder(painter, QRectF(item.block->geometry().adjusted(around, around, -around, -around)),
                                   shadow_);
        }
    }
}

}  // namespace ktr::app
