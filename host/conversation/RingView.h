#pragma once

#include <QColor>
#include <QRectF>

#include "platform/ui/View.h"

class QPainter;

namespace ktr::host {

/// The ring in a card's header while a place is being looked for: a faint track and an arc that goes round in a window
/// and stands still in a picture. Main thread.
class RingView : public platform::View {
  public:
    RingView() { setUserInteractionEnabled(false); }
    /// Where the arc begins, in turns clockwise from the top.
    void setTurn(double turn);
    /// How much of the circle the arc covers, from 0 to 1; a quarter, or three quarters where nothing may move.
    void setShare(double share);
    /// The same ring wherever else something is under way.
    static void paint(QPainter& painter, const QRectF& box, const QColor& color, double turn, double share);

  protected:
    void draw(platform::Canvas& canvas) const override;

  private:
    double turn_ = 0.0;
    double share_ = 0.25;
};

}  // namespace ktr::host
