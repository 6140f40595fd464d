#include "app/conversation/ConversationView.h"

#include <QPainter>

#include "app/conversation/Measures.h"
#include "app/conversation/Shapes.h"
#include "linux/ui/QtAppearance.h"
#include "platform/base/Platform.h"

namespace ktr::app {

void ConversationView::addTurn(const std::shared_ptr<TurnView>& turn) {
    turns_.push_back(turn);
    if (softColor_) {
        turn->setSoftColor(*softColor_);
    }
    addSubview(turn);
}

void ConversationView::removeTurn(const std::shared_ptr<TurnView>& turn) {
    std::erase(turns_, turn);
    turn->removeFromSuperview();
}

double ConversationView::layOut(double width) {
    const bool wide = width >= measures::kWideFrom;
    double y = wide ? measures::kWideTop : 0.0;
    for (const auto& turn : turns_) {
        const bool first = turn == turns_.front();
        if (wide && !first) {
            y += measures::kCardToQuestion;
        }
        const double height = turn->layOut(width, first);
        turn->setFrame({0.0, y, width, height});
        y += height;
    }
    y += wide ? measures::kWideBottom : measures::kPhoneBottom;
    setFrame({0.0, 0.0, width, y});
    layoutIfNeeded();
    return y;
}

void ConversationView::setPalette(const linux_::Palette& palette) {
    const QColor& soft = palette.inkSoft;
    softColor_ = platform::Color::rgb(soft.redF(), soft.greenF(), soft.blueF());
    for (const auto& turn : turns_) {
        turn->setSoftColor(*softColor_);
    }
    setNeedsDisplay();
    // Maps ask for pictures that fit.
    const auto installed = platform::Platform::installed();
    if (const auto shown =
            std::dynamic_pointer_cast<linux_::QtAppearance>(installed ? installed->appearance : nullptr)) {
        shown->show(palette.scheme, palette.contrast);
    }
}

void ConversationView::draw(platform::Canvas& canvas) const {
    auto* qt = qtCanvas(canvas);
    if (qt == nullptr) {
        return;
    }
    const QRectF visible = qt->painter().clipBoundingRect();
    for (const auto& turn : turns_) {
        if (turn->card()->hidden()) {
            continue;
        }
        const platform::Rect card = turn->card()->frame().offsetBy(turn->frame().x, turn->frame().y);
        const QRectF shape = toQt(card);
        constexpr double kReach = CardShadow::kReach;
        if (visible.isNull() || visible.intersects(shape.adjusted(-kReach, -kReach, kReach, kReach))) {
            shadow_.paint(*qt, shape, measures::kCardCorner);
        }
    }
}

}  // namespace ktr::app
