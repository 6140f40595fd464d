#include "platform/base/NotificationCenter.h"

#include <vector>

namespace ktr::platform {

struct NotificationCenter::Token::State {
    struct Observer {
        std::string name;
        std::shared_ptr<const Handler> handler;
    };
    mutable std::mutex mutex;
    std::uint64_t nextId = 1;
    std::map<std::uint64_t, Observer> observers;
};

NotificationCenter::Token::Token(Token&& other) noexcept : state_(std::move(other.state_)), id_(other.id_) {
    other.state_.reset();
}

NotificationCenter::Token& NotificationCenter::Token::operator=(Token&& other) noexcept {
    if (this != &other) {
        remove();
        state_ = std::move(other.state_);
        id_ = other.id_;
        other.state_.reset();
    }
    return *this;
}

NotificationCenter::Token::~Token() {
    remove();
}

void NotificationCenter::Token::remove() {
    const auto state = state_.lock();
    state_.reset();
    if (!state) {
        return;
    }
    // The handler is destroyed outside the lock: it may own tokens itself.
    decltype(state->observers)::node_type removed;
    const std::lock_guard lock(state->mutex);
    removed = state->observers.extract(id_);
}

NotificationCenter::NotificationCenter() : state_(std::make_shared<Token::State>()) {}
NotificationCenter::~NotificationCenter() = default;

NotificationCenter::Token NotificationCenter::addObserver(std::string name, Handler handler) {
    const std::lock_guard lock(state_->mutex);
    const std::uint64_t id = state_->nextId++;
    state_->observers.emplace(
        id, Token::State::Observer{std::move(name), std::make_shared<const Handler>(std::move(handler))});
    return Token(state_, id);
}

void NotificationCenter::post(const Notification& notification) {
    const auto state = state_;
    std::vector<std::uint64_t> ids;
    {
        const std::lock_guard lock(state->mutex);
        for (const auto& [id, observer] : state->observers) {
            if (observer.name == notification.name) {
                ids.push_back(id);
            }
        }
    }
    for (const std::uint64_t id : ids) {
        std::shared_ptr<const Handler> handler;
        {
            const std::lock_guard lock(state->mutex);
            const auto found = state->observers.find(id);
            if (found != state->observers.end()) {
                handler = found->second.handler;
            }
        }
        if (handler) {
            (*handler)(notification);
        }
    }
}

std::size_t NotificationCenter::observerCount() const {
    const std::lock_guard lock(state_->mutex);
    return state_->observers.size();
}

}  // namespace ktr::platform
