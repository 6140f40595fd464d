#include "host/conversation/Icon.h"

#include <QPainter>
#include <QSvgRenderer>

namespace ktr::host {

namespace {

struct Drawing {
    double side;
    double stroke;
    const char* path;
    bool pointsSomewhere = false;
};

/// Paths as SVG writes them, each in a square box.
Drawing drawingOf(Icon icon) {
    switch (icon) {
        case Icon::None:
            break;
        case Icon::Back:
            return {20, 2, "M16.5 10H4M9.5 4.5 4 10l5.5 5.5", true};
        case Icon::Call:
            return {20, 1.7,
                    "M5.2 3.2 7.6 3l1.5 3.8-1.8 1.5c.8 1.9 2.3 3.4 4.2 4.3l1.6-1.8 3.8 1.5-.2 2.5c-.1 1.2-1.1 2-2.3 "
                    "1.9C8.7 16.1 3.7 11.2 3.1 5.5 3 4.3 3.9 3.3 5.2 3.2z"};
        case Icon::Write:
            return {20, 1.7,
                    "M3.5 6.6A2.6 2.6 0 0 1 6.1 4h7.8a2.6 2.6 0 0 1 2.6 2.6v4.6a2.6 2.6 0 0 1-2.6 2.6H9.2L5.6 "
                    "16.6v-2.8A2.3 2.3 0 0 1 3.5 11.4z"};
        case Icon::OpenInMaps:
            return {20, 1.7,
                    "M3.5 5.3 7.7 3.5l4.6 1.8 4.2-1.8v11.2l-4.2 1.8-4.6-1.8-4.2 1.8zM7.7 3.5v11.2M12.3 5.3v11.2"};
        case Icon::Copy:
            return {
                20, 1.7,
                "M7.2 7.2h7.3a2 2 0 0 1 2 2v5.3a2 2 0 0 1-2 2H9.2a2 2 0 0 1-2-2zM4.5 12.8a1.5 1.5 0 0 1-1-1.4V5.5a2 "
                "2 0 0 1 2-2h5.9a1.5 1.5 0 0 1 1.4 1"};
        case Icon::TellMe:
            return {20, 1.7, "M5.2 13.8V9.2a4.8 4.8 0 0 1 9.6 0v4.6l1.4 1.2H3.8zM8.3 17.1h3.4"};
        case Icon::Again:
            return {20, 1.8, "M15.8 8.2A6.3 6.3 0 1 0 16.2 11M16.2 4.2v4.1h-4.1"};
        case Icon::Unlock:
            return {20, 1.7,
                    "M5.5 9.2h9a1.5 1.5 0 0 1 1.5 1.5v4.8a1.5 1.5 0 0 1-1.5 1.5h-9A1.5 1.5 0 0 1 4 15.5v-4.8a1.5 1.5 0 "
                    "0 1 1.5-1.5zM6.8 9.2V6.4a3.2 3.2 0 0 1 6.4 0v2.8"};
        case Icon::Settings:
            return {20, 1.7,
                    "M3.5 6h6.2M14.3 6h2.2M3.5 14h2.2M10.3 14h6.2M12 3.7a2.3 2.3 0 1 1 0 4.6 2.3 2.3 0 0 1 0-4.6zM8 "
                    "11.7a2.3 2.3 0 1 1 0 4.6 2.3 2.3 0 0 1 0-4.6z"};
        case Icon::Show:
            return {20, 1.7,
                    "M2.5 10c1.8-3.3 4.3-5 7.5-5s5.7 1.7 7.5 5c-1.8 3.3-4.3 5-7.5 5s-5.7-1.7-7.5-5zM10 7.6a2.4 2.4 0 1 "
                    "1 0 4.8 2.4 2.4 0 0 1 0-4.8z"};
        case Icon::More:
            return {20, 2, "M10 4v12M4 10h12"};
        case Icon::Less:
            return {20, 2, "M4 10h12"};
        case Icon::Fine:
            return {16, 1.9, "M3.3 8.4 6.5 11.6 12.7 4.8"};
        case Icon::Chevron:
            return {16, 1.8, "M6.2 4 10.2 8l-4 4", true};
        case Icon::Warning:
            return {14, 1.5, "M7 1.6 13 12.2H1zM7 5.4v3.2M7 10.5v.02"};
    }
    return {20, 1, ""};
}

}  // namespace

double iconSide(Icon icon) {
    return drawingOf(icon).side;
}

void paintIcon(QPainter& painter, Icon icon, const QRectF& rect, const QColor& color, bool isMirrored) {
    if (icon == Icon::None) {
        return;
    }
    const Drawing drawing = drawingOf(icon);
    const QString source = QStringLiteral(
                               "<svg xmlns=\"http://www.w3.org/2000/svg\" viewBox=\"0 0 %1 %1\"><path d=\"%2\" "
                               "fill=\"none\" stroke=\"%3\" stroke-width=\"%4\" stroke-linecap=\"round\" "
                               "stroke-linejoin=\"round\"/></svg>")
                               .arg(drawing.side)
                               .arg(QLatin1String(drawing.path), color.name())
                               .arg(drawing.stroke);
    QSvgRenderer renderer(source.toUtf8());
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    if (isMirrored && drawing.pointsSomewhere) {
        painter.translate(rect.left() + rect.right(), 0.0);
        painter.scale(-1.0, 1.0);
    }
    renderer.render(&painter, rect);
    painter.restore();
}

}  // namespace ktr::host
