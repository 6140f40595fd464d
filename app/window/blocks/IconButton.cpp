#include "app/window/blocks/IconButton.h"

#include <QPainter>

namespace ktr::app {

IconButton::IconButton(Icon icon, Tone tone, QWidget* parent) : PressBlock(parent), icon_(icon), tone_(tone) {}

void IconButton::setName(const QString& name) {
    setAccessibleName(name);
    setToolTip(name);
}

void IconButton::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const QRectF target = rect();
    const double corner = std::min(target.width(), target.height()) / 2.0;
    // The ring stands in the target: nothing around it may be covered.
    const QRectF disc = target.adjusted(3, 3, -3, -3);
    paintTouch(painter, rounded(disc, corner));
    if (isHovered() && colors().highlightEdge.width > 0.0) {
        strokeInside(painter, disc, corner, QPen(colors().highlightEdge.color, colors().highlightEdge.width));
    }
    const QColor tone = tone_ == Tone::Pine ? colors().pine : tone_ == Tone::Soft ? colors().inkSoft : colors().ink;
    const double side = grown(iconSide(icon_));
    paintIcon(painter, icon_, {target.center().x() - side / 2.0, target.center().y() - side / 2.0, side, side},
              isEnabled() ? tone : colors().inkSoft, isMirrored());
    if (marksFocus()) {
        strokeInside(painter, target, corner, QPen(colors().pine, colors().focusRing));
    }
}

}  // namespace ktr::app
