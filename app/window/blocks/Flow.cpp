#include "app/window/blocks/Flow.h"

#include <QEvent>
#include <algorithm>

namespace ktr::app {

void Flow::add(Block* block) {
    block->setParent(this);
    block->setLook(look());
    block->show();
    blocks_.push_back(block);
    place();
    askForRoom();
}

void Flow::clear() {
    for (Block* block : blocks_) {
        block->hide();
        block->deleteLater();
    }
    blocks_.clear();
    askForRoom();
}

std::vector<Block*> Flow::seen() const {
    std::vector<Block*> seen;
    std::copy_if(blocks_.begin(), blocks_.end(), std::back_inserter(seen),
                 [](const Block* b) { return !b->isHidden(); });
    return seen;
}

std::vector<QRect> Flow::plan(int width) const {
    const auto blocks = seen();
    int together = -gap_;
    for (const Block* block : blocks) {
        together += block->naturalWidth() + gap_;
    }
    std::vector<QRect> places;
    const bool isSideBySide = !isAtEnd_ && together <= width;
    const int spare = isFilling_ && isSideBySide && !blocks.empty() ? width - together : 0;
    int x = 0, y = 0, highest = 0;
    for (std::size_t i = 0; i < blocks.size(); ++i) {
        // What is left over goes to the first: the one that matters most.
        const int own = std::min(blocks[i]->naturalWidth(), width) + (i == 0 ? spare : 0);
        const int across = isFilling_ && !isSideBySide ? width : own;
        const int high = blocks[i]->shapeHeight(across);
        places.emplace_back(isAtEnd_ ? width - across : x, y, across, high);
        highest = std::max(highest, high);
        (isSideBySide ? x : y) += gap_ + (isSideBySide ? across : high);
    }
    for (QRect& rect : places) {
        rect.setHeight(isSideBySide ? highest : rect.height());
    }
    return places;
}

int Flow::shapeHeight(int width) const {
    int height = 0;
    for (const QRect& rect : plan(width)) {
        height = std::max(height, rect.y() + rect.height());
    }
    return height;
}

void Flow::place() {
    const auto blocks = seen();
    const auto places = plan(shape().width());
    for (std::size_t i = 0; i < blocks.size(); ++i) {
        blocks[i]->placeShape(mirrored(QRectF(places[i].translated(kAround, kAround))).toRect());
    }
}

void Flow::resizeEvent(QResizeEvent*) {
    place();
}

bool Flow::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        askForRoom();
        return true;
    }
    return Block::event(event);
}

}  // namespace ktr::app
