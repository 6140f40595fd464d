#include "app/window/ScrollBarStyle.h"

namespace ktr::app {

QString scrollBarStyle(const linux_::Palette& palette) {
    QColor handle = palette.inkSoft;
    handle.setAlphaF(palette.contrast == linux_::Contrast::High ? 1.0F : 0.45F);
    return QStringLiteral(
               "QScrollBar:vertical { background: transparent; width: %1px; border: none; }"
               "QScrollBar::handle:vertical { background: %2; border-radius: 3px; margin: 1px; "
               "min-height: 32px; }"
               "QScrollBar::add-line, QScrollBar::sub-line { height: 0; }"
               "QScrollBar::add-page, QScrollBar::sub-page { background: none; }")
        .arg(kScrollBarWidth)
        .arg(handle.name(QColor::HexArgb));
}

}  // namespace ktr::app
