#include "app/window/blocks/ListCard.h"

#include <QEvent>
#include <QPainter>

#include "host/conversation/CardShadow.h"
#include "host/conversation/Measures.h"

namespace ktr::app {

using host::measures::kCardCorner;

ListCard::ListCard(QWidget* parent) : Block(parent) {}

void ListCard::add(Block* row) {
    row->setParent(this);
    row->setLook(look());
    row->show();
    rows_.push_back(row);
    place();
    askForRoom();
}

void ListCard::clear() {
    for (Block* row : rows_) {
        row->hide();
        row->deleteLater();
    }
    rows_.clear();
    askForRoom();
}

int ListCard::shapeHeight(int width) const {
    int height = 0;
    for (const Block* row : rows_) {
        height += row->isHidden() ? 0 : row->shapeHeight(width);
    }
    return height;
}

void ListCard::place() {
    int y = 0;
    Block* last = nullptr;
    bool isFirst = true;
    for (Block* row : rows_) {
        if (row->isHidden()) {
            continue;
        }
        const int high = row->shapeHeight(width());
        row->placeShape({0, y, width(), high});
        if (auto* list = dynamic_cast<ListRow*>(row)) {
            list->setEnds(isFirst, false);
        }
        isFirst = false;
        last = row;
        y += high;
    }
    if (auto* list = dynamic_cast<ListRow*>(last)) {
        list->setEnds(list->y() == 0, true);
    }
    update();
}

void ListCard::resizeEvent(QResizeEvent*) {
    place();
}

bool ListCard::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) {
        place();
        askForRoom();
        return true;
    }
    return Block::event(event);
}

void ListCard::paintUnder(QPainter& painter, const QRectF& shape, host::CardShadow& shadow) const {
    if (colors().cardShadow.alpha() > 0) {
        linux_::QtCanvas canvas(painter, colors());
        shadow.paint(canvas, shape, kCardCorner);
    }
}

void ListCard::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF box = rect();
    painter.fillPath(rounded(box, kCardCorner), colors().card);
    if (colors().cardEdge.width > 0.0) {
        strokeInside(painter, box, kCardCorner, QPen(colors().cardEdge.color, colors().cardEdge.width));
    }
    painter.setRenderHint(QPainter::Antialiasing, false);
    const double pixel = 1.0 / devicePixelRatioF();
    for (const Block* row : rows_) {
        if (isParted_ && !row->isHidden() && row->y() > 0) {
            painter.fillRect(QRectF(0, row->y(), width(), pixel), linux_::Palette::separator());
        }
    }
}

}  // namespace ktr::app
