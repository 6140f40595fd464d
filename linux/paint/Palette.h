#pragma once

#include <QColor>

#include "platform/ui/Color.h"

namespace ktr::linux_ {

enum class ColorScheme { Light, Dark };
enum class Contrast { Normal, High };

/// The colours of the interface for one appearance. A value; any thread.
class Palette {
  public:
    /// An edge drawn inside a shape: none when its width is 0. Points.
    struct Edge {
        QColor color;
        double width = 0.0;
    };

    static const Palette& of(ColorScheme scheme, Contrast contrast = Contrast::Normal);

    /// The same with the user's own colour in the place of `pine`: as near to it as still reads on every ground and
    /// under `onPine` (WCAG 2.1, 1.4.3: 4.5 to 1). High contrast keeps its own, and so do the colours of maps.
    Palette withAccent(const QColor& accent) const;

    /// What a colour of the plugin looks like here: roles are looked up, fixed colours stand as they are.
    QColor resolve(const platform::Color& color) const;

    ColorScheme scheme = ColorScheme::Light;
    Contrast contrast = Contrast::Normal;

    QColor window;              ///< behind everything
    QColor card;                ///< cards and the input field
    Edge cardEdge;              ///< a card's inner edge
    QColor bubble;              ///< the question
    Edge bubbleEdge;            ///< the same of its edge
    QColor highlight;           ///< a row under a mouse or pen: the selection colour
    Edge highlightEdge;         ///< the same of its edge
    QColor ink;                 ///< all text in rows, question, sentence: the standard text colour
    QColor inkSoft;             ///< the host's time, status, placeholder
    QColor pine;                ///< focus, caret, chevron, live dot, send
    QColor onPine;              ///< on `pine`
    QColor fieldLine;           ///< edge of the input field, 1 point
    QColor sendIdle;            ///< the send button with nothing to send
    Edge sendIdleEdge;          ///< the same of its edge
    QColor amber;               ///< the location indicator
    QColor warning;             ///< the mark before a warning
    QColor fence;               ///< the fence marker on a map
    QColor fenceIcon;           ///< the fence icon outside a map
    QColor cardShadow;          ///< of both shadows under a card; transparent where cards cast none
    QColor mapLand;             ///< the ground of a map without a picture
    QColor mapNote;             ///< words on it
    QColor mapScale;            ///< the scale bar
    QColor mapScaleHalo;        ///< around it
    QColor mapAttribution;      ///< whose data a map shows
    QColor mapAttributionPill;  ///< behind it
    QColor mapUserHalo;         ///< around the user
    QColor friendPinEdge;       ///< around a friend's pin
    QColor markerPinEdge;       ///< around a marker
    double focusRing = 2;       ///< points

    /// The same in every appearance.
    static QColor separator() { return QColor(151, 158, 149); }
    static QColor friendOrange() { return QColor(239, 143, 20); }
    static QColor pinShadow() { return QColor(43, 26, 5, 71); }  // alpha 0.28
    static QColor pressed() { return QColor(0, 0, 0, 51); }
};

}  // namespace ktr::linux_
