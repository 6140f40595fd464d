#include "serve/SharingState.h"

namespace ktr::serve {

SharingState::Sharing SharingState::now() const {
    const std::lock_guard<std::mutex> lock(mutex_);
    return sharing_;
}

void SharingState::wish(bool hidden) {
    const std::lock_guard<std::mutex> lock(mutex_);
    wishesToHide_ = hidden;
    sharing_.hidden = hidden;
}

void SharingState::command(bool hidden, const std::optional<Position>& position) {
    const std::lock_guard<std::mutex> lock(mutex_);
    sharing_.hidden = hidden || wishesToHide_;
    if (position) {
        sharing_.position = position;
    }
}

}  // namespace ktr::serve
