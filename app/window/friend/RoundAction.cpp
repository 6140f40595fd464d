#include "app/window/friend/RoundAction.h"

#include <QPainter>

namespace ktr::app {

RoundAction::RoundAction(Icon icon, const QString& words, QWidget* parent) : PressBlock(parent), icon_(icon) {
    setWords(words);
}

void RoundAction::setWords(const QString& words) {
    if (words != words_.text()) {
        words_ = BlockText(words, BlockStyle::Footnote);
        setAccessibleName(words);
        askForRoom();
    }
}

int RoundAction::shapeHeight(int width) const {
    const int disc = controlHeight(kDisc);
    if (isVeryLarge()) {
        return std::max(disc, words_.heightFor(width - disc - 2 * kBeside)) + 2 * kRoom;
    }
    return disc + kToWords + words_.heightFor(width) + 2 * kRoom;
}

void RoundAction::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    const double side = controlHeight(kDisc);
    const bool isBeside = isVeryLarge();
    const QRectF disc = mirrored({isBeside ? kBeside : (width() - side) / 2.0, static_cast<double>(kRoom), side, side});
    const QPainterPath shape = rounded(disc, side / 2.0);
    painter.fillPath(shape, colors().card);
    paintTouch(painter, shape);
    strokeInside(painter, disc, side / 2.0, QPen(colors().fieldLine, 1.0));
    const double icon = iconSide(icon_) * (isBeside ? 1.6 : 1.0);
    paintIcon(painter, icon_, {disc.center().x() - icon / 2.0, disc.center().y() - icon / 2.0, icon, icon},
              colors().pine, isMirrored());
    if (marksFocus()) {
        const double out = 2.0 + colors().focusRing;
        strokeInside(painter, disc.adjusted(-out, -out, out, out), side / 2.0 + out,
                     QPen(colors().pine, colors().focusRing));
    }
    if (isBeside) {
        const double start = 2.0 * kBeside + side;
        const double height = words_.heightFor(width() - start);
        words_.paint(painter, mirrored({start, (this->height() - height) / 2.0, width() - start, height}), colors().ink,
                     colors(), isMirrored());
    } else {
        words_.paint(painter, QRectF(0.0, kRoom + side + kToWords, width(), height() - kRoom - side - kToWords),
                     colors().ink, colors(), isMirrored(), BlockAlignment::Centre);
    }
}

}  // namespace ktr::app
