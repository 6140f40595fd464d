#include "host/conversation/ConversationView.h"

#include <QPainter>
#include <algorithm>
#include <utility>

#include "host/conversation/Measures.h"
#include "host/conversation/Shapes.h"
#include "linux/paint/QtAppearance.h"
#include "platform/assistant/AssistantSettings.h"
#include "platform/base/Platform.h"

namespace ktr::host {

namespace {

std::shared_ptr<linux_::QtAppearance> shownAppearance() {
    const auto installed = platform::Platform::installed();
    return std::dynamic_pointer_cast<linux_::QtAppearance>(installed ? installed->appearance : nullptr);
}

}  // namespace

void ConversationView::addTurn(const std::shared_ptr<TurnView>& turn) {
    turns_.push_back(turn);
    turn->setMotionStyle(style_);
    turn->setGetStreets(getStreets_);
    if (palette_ != nullptr) {
        turn->setPalette(*palette_);
    }
    addSubview(turn);
}

void ConversationView::setGetStreets(std::function<void()> get) {
    getStreets_ = std::move(get);
    for (const auto& turn : turns_) {
        turn->setGetStreets(getStreets_);
    }
}

void ConversationView::removeTurn(const std::shared_ptr<TurnView>& turn) {
    std::erase(turns_, turn);
    turn->removeFromSuperview();
}

double ConversationView::layOut(double width) {
    for (const auto& turn : turns_) {
        turn->setShowsTime(showsTimes_);
        turn->layOut(width, turn == turns_.front());
    }
    head_ = headFor(width);
    stack(width);
    return frame().height;
}

double ConversationView::headFor(double width) const {
    if (width >= measures::kWideFrom || turns_.empty()) {
        return 0.0;
    }
    const platform::Rect corner{width - corner_.width, 0.0, corner_.width, corner_.height};
    const bool isRightToLeft = platform::Platform::installed()->assistant->languageIsRightToLeft();
    const bool isMet = turns_.front()->showsSomethingIn(mirrored(corner, width, isRightToLeft));
    return isMet ? corner_.height + measures::kCornerToTurn - measures::kTimeAbove : 0.0;
}

bool ConversationView::showsSomethingIn(const platform::Rect& rect) const {
    return std::any_of(turns_.begin(), turns_.end(), [&](const auto& turn) {
        return turn->frame().intersects(rect) &&
               turn->showsSomethingIn(rect.offsetBy(-turn->frame().x, -turn->frame().y));
    });
}

void ConversationView::stack(double width) {
    const bool wide = width >= measures::kWideFrom;
    double y = wide ? measures::kWideTop : head_;
    for (const auto& turn : turns_) {
        if (wide && turn != turns_.front()) {
            y += measures::kCardToQuestion;
        }
        turn->setFrame({0.0, y + turn->rise(), width, turn->height()});
        y += turn->height();
    }
    y += wide ? measures::kWideBottom : measures::kPhoneBottom;
    setFrame({0.0, 0.0, width, y});
    layoutIfNeeded();
}

double ConversationView::topOf(const TurnView& turn) const {
    return turn.superview().get() == this ? turn.frame().y - turn.rise() : 0.0;
}

void ConversationView::setMotionStyle(MotionStyle style) {
    style_ = style;
    for (const auto& turn : turns_) {
        turn->setMotionStyle(style);
    }
    // None is for a moment; what glides meanwhile goes on.
    if (const auto shown = shownAppearance(); shown && style != MotionStyle::None) {
        shown->setReducesMotion(style == MotionStyle::Reduced);
    }
}

bool ConversationView::advance(double now) {
    const bool moved = moves_;
    moves_ = false;
    for (const auto& turn : turns_) {
        moves_ = turn->advance(now) || moves_;
    }
    if (moved || moves_) {
        stack(frame().width);
        setNeedsDisplay();
    }
    return moves_;
}

void ConversationView::setPalette(const linux_::Palette& palette) {
    palette_ = &palette;
    for (const auto& turn : turns_) {
        turn->setPalette(palette);
    }
    setNeedsDisplay();
    // Maps ask for pictures that fit.
    if (const auto shown = shownAppearance()) {
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
            const double whole = qt->painter().opacity();
            qt->painter().setOpacity(whole * turn->cardOpacity());
            shadow_.paintAround(*qt, shape, measures::kCardCorner);
            qt->painter().setOpacity(whole);
        }
    }
}

}  // namespace ktr::host
