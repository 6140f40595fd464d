#include "host/conversation/FadeView.h"

#include <QPainter>

#include "host/conversation/Shapes.h"

namespace ktr::host {

void FadeView::setOpacity(double opacity) {
    if (opacity != opacity_) {
        opacity_ = opacity;
        setNeedsDisplay();
    }
}

void FadeView::draw(platform::Canvas& canvas) const {
    auto* qt = qtCanvas(canvas);
    if (qt != nullptr && opacity_ < 1.0) {
        // Holds for everything in the view: the caller restores the canvas when it leaves it.
        qt->painter().setOpacity(qt->painter().opacity() * opacity_);
    }
}

}  // namespace ktr::host
