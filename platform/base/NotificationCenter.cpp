#include "platform/base/NotificationCenter.h"

#include <vector>

namespace ktr::platform {

struct NotificationCenter::Token::State {
    /// In the order of registration.
    using Handlers = std::map<std::uint64_t, std::shared_ptr<const Handler>>;

    /// None when it is not, or no longer, registered.
    std::shared_ptr<const Handler> handler(const std::string& name, std::uint64_t id) const {
        const std::lock_guard lock(mutex);
        const auto named = observers.find(name);
        if (named == observers.end()) {
            return nullptr;
        }
        const auto found = named->second.find(id);
        return found == named->second.end() ? nullptr : found->second;
    }

    mutable std::mutex mutex;
    std::uint64_t nextId = 1;
    /// By name, so that a thousand rows that observe the same do not each keep what it is called.
    std::map<std::string, Handlers> observers;
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
    State::Handlers::node_type removed;
    const std::lock_guard lock(state->mutex);
    for (auto named = state->observers.begin(); named != state->observers.end(); ++named) {
        removed = named->second.extract(id_);
        if (!removed.empty()) {
            if (named->second.empty()) {
                state->observers.erase(named);
            }
            return;
        }
    }
}

NotificationCenter::NotificationCenter() : state_(std::make_shared<Token::State>()) {}
NotificationCenter::~NotificationCenter() = default;

NotificationCenter::Token NotificationCenter::addObserver(std::string name, Handler handler) {
    const std::lock_guard lock(state_->mutex);
    const std::uint64_t id = state_->nextId++;
    state_->observers[std::move(name)].emplace(id, std::make_shared<const Handler>(std::move(handler)));
    return Token(state_, id);
}

void NotificationCenter::post(const Notification& notification) {
    const auto state = state_;
    std::vector<std::uint64_t> ids;
    {
        const std::lock_guard lock(state->mutex);
        if (const auto named = state->observers.find(notification.name); named != state->observers.end()) {
            ids.reserve(named->second.size());
            for (const auto& [id, handler] : named->second) {
                ids.push_back(id);
            }
        }
    }
    for (const std::uint64_t id : ids) {
        if (const auto handler = state->handler(notification.name, id)) {
            (*handler)(notification);
        }
    }
}

std::size_t NotificationCenter::observerCount() const {
    const std::lock_guard lock(state_->mutex);
    std::size_t count = 0;
    for (const auto& [name, handlers] : state_->observers) {
        count += handlers.size();
    }
    return count;
}

}  // namespace ktr::platform
