#include "app/serve/SharingState.h"

namespace ktr::app {

SharingState::Sharing SharingState::now() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return sharing_;
}

void SharingState::setHidden(bool hidden) {
    set(hidden, std::nullopt);
}

void SharingState::set(bool hidden, const std::optional<Position>& position) {
    const std::lock_guard<std::mutex> lock(mutex_);
    sharing_.hidden = hidden;
    if (position) {
        sharing_.position = position;
    }
}

}  // namespace ktr::app
