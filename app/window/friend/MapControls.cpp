#include "app/window/friend/MapControls.h"

#include <QPainter>

namespace ktr::app {

IconButton& MapControls::add(Icon icon, IconButton::Tone tone) {
    buttons_.push_back(new IconButton(icon, tone, this));
    return *buttons_.back();
}

int MapControls::shapeHeight(int /*width*/) const {
    const int count = static_cast<int>(buttons_.size());
    return count * IconButton::side() + std::max(count - 1, 0);
}

void MapControls::resizeEvent(QResizeEvent*) {
    int y = 0;
    for (IconButton* button : buttons_) {
        button->placeShape({0, y, width(), IconButton::side()});
        y += IconButton::side() + 1;
    }
}

void MapControls::paintEvent(QPaintEvent*) {
    constexpr double kHairlineIn = 8.0;
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.fillPath(rounded(rect(), corner()), colors().card);
    strokeInside(painter, rect(), corner(), QPen(colors().cardEdge.color, colors().cardEdge.width));
    painter.setRenderHint(QPainter::Antialiasing, false);
    for (std::size_t i = 1; i < buttons_.size(); ++i) {
        const double y = static_cast<double>(i) * (IconButton::side() + 1) - 1.0;
        painter.fillRect(QRectF(kHairlineIn, y, width() - 2.0 * kHairlineIn, 1.0), linux_::Palette::separator());
    }
}

}  // namespace ktr::app
