#pragma once

#include <QImage>
#include <QRectF>
#include <vector>

#include "linux/paint/QtCanvas.h"

namespace ktr::host {

/// Paints the two shadows under cards: 0 1 2 and 0 8 24 -6 (offset, blur and spread in points), each in the palette's
/// shadow colour. A blur of b is a Gaussian of standard deviation b / 2. What was blurred once for a scale is kept and
/// stretched to cards of any size. Main thread.
class CardShadow {
  public:
    /// Points that a shadow reaches beyond its card.
    static constexpr double kReach = 44.0;

    void paint(linux_::QtCanvas& canvas, const QRectF& card, double corner);
    /// The same where a card of this shape, which nothing shows through, is painted over it at once: what the card
    /// hides is left out, which is nearly all of a tall card's shadow. A painter that is not opaque paints all of it.
    void paintAround(linux_::QtCanvas& canvas, const QRectF& card, double corner);
    /// How many shapes were blurred.
    std::size_t blurs() const { return kept_.size(); }

  private:
    /// What is not seen; empty for nothing. `tall` reaches nearly to the left and right edge, `wide` to top and bottom.
    struct Hidden {
        QRectF tall;
        QRectF wide;
    };
    struct Blurred {
        double sigma = 0.0;
        double corner = 0.0;
        double scale = 0.0;
        QRgb color = 0;
        QImage image;         ///< of the smallest rounded rectangle; its middle pixel is stretched
        double margin = 0.0;  ///< points around that rectangle
        double edge = 0.0;    ///< points from the image's border to the stretched middle
    };

    void paintLayers(linux_::QtCanvas& canvas, const QRectF& card, double corner, const Hidden& hidden);
    void paintOne(linux_::QtCanvas& canvas, const QRectF& shape, double corner, double sigma, const Hidden& hidden);
    static void stretch(QPainter& painter, const Blurred& blurred, const QRectF& shape, const Hidden& hidden);
    const Blurred& blurred(double sigma, double corner, double scale, const QColor& color);

    std::vector<Blurred> kept_;
};

}  // namespace ktr::host
