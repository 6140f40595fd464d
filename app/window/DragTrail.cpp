#include "app/window/DragTrail.h"

#include <utility>

namespace ktr::app {

QPointF DragTrail::move(QPointF at, double time) {
    if (samples_.empty()) {
        begin(at, time);
        return {};
    }
    const QPointF moved = at - samples_.back().at;
    samples_.push_back({at, time});
    while (samples_.size() > 2 && time - samples_.front().time > kMemory) {
        samples_.pop_front();
    }
    return moved;
}

QPointF DragTrail::release(double time) {
    const auto samples = std::exchange(samples_, {});
    if (samples.size() < 2 || time - samples.back().time > kMemory) {
        return {};
    }
    const double seconds = samples.back().time - samples.front().time;
    return seconds > 0.0 ? (samples.back().at - samples.front().at) / seconds : QPointF();
}

}  // namespace ktr::app
