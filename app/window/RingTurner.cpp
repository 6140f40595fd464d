#include "app/window/RingTurner.h"

#include <cmath>
#include <utility>

namespace ktr::app {

namespace {

constexpr int kStep = 32;        // milliseconds
constexpr int kStillStep = 500;  // milliseconds
constexpr double kTurn = 1.2;    // seconds
constexpr double kShare = 0.25;  // of the circle, while it turns
constexpr double kStillShare = 0.75;

}  // namespace

RingTurner::RingTurner(std::shared_ptr<host::ConversationView> conversation, std::function<bool()> isStill,
                       std::function<bool(const host::TurnView&)> isSeen)
    : conversation_(std::move(conversation)), isStill_(std::move(isStill)), isSeen_(std::move(isSeen)) {
    clock_.start();
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] { update(); });
}

void RingTurner::update() {
    const bool still = isStill_();
    const double turns = static_cast<double>(clock_.nsecsElapsed()) * 1e-9 / kTurn;
    bool any = false;
    for (const auto& turn : conversation_->turns()) {
        turn->card()->updateRing();
        for (const auto& ring : {turn->card()->ring(), turn->ring()}) {
            if (!ring->hidden() && isSeen_(*turn)) {
                any = true;
                ring->setShare(still ? kStillShare : kShare);
                ring->setTurn(still ? 0.0 : std::fmod(turns, 1.0));
            }
        }
    }
    // Also for rings that stand still: they go when the search is over.
    const int step = still ? kStillStep : kStep;
    if (!any) {
        timer_.stop();
    } else if (!timer_.isActive() || timer_.interval() != step) {
        timer_.start(step);
    }
}

}  // namespace ktr::app
