#pragma once

#include <QColor>
#include <QRectF>

class QPainter;

namespace ktr::host {

/// The icons of controls. Drawn as lines of one colour; Main thread.
enum class Icon {
    None,
    Back,
    Call,
    Write,
    OpenInMaps,
    Copy,
    TellMe,
    Again,
    Unlock,
    Settings,
    Show,  ///< a secret
    More,
    Less,
    Fine,
    Chevron,
    Warning,
};

/// The side of the square that an icon is drawn in at the usual text size.
double iconSide(Icon icon);
/// Fills the rectangle; `isMirrored` matters only to icons that point somewhere.
void paintIcon(QPainter& painter, Icon icon, const QRectF& rect, const QColor& color, bool isMirrored);

}  // namespace ktr::host
