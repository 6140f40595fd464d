#include "serve/SharingState.h"

namespace ktr::serve {

SharingState::Sharing SharingState::now() const {
    const auto person = store_->person(person_);
    const std::lock_guard<std::mutex> lock(mutex_);
    // What is not known is hidden.
    return {!person || person->hidden, position_};
}

void SharingState::wished(bool hides) {
    const std::lock_guard<std::mutex> lock(mutex_);
    wishesToHide_ = hides;
    if (!hides) {
        store_->askToShare(reader_, nullptr);
    }
}

void SharingState::commanded(bool hides, const std::optional<Position>& position) {
    const std::lock_guard<std::mutex> lock(mutex_);
    if (hides && !wishesToHide_) {
        store_->askToShare(reader_, nullptr);
    }
    if (position) {
        position_ = position;
    }
}

}  // namespace ktr::serve
