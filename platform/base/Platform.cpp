#include "platform/base/Platform.h"

#include <atomic>
#include <utility>

#include "platform/base/CurrentPlatform.h"
#include "platform/base/NotificationCenter.h"

namespace ktr::platform {

namespace {

std::mutex& installMutex() {
    static std::mutex mutex;
    return mutex;
}

std::shared_ptr<Platform>& slot() {
    static std::shared_ptr<Platform> platform;
    return platform;
}

}  // namespace

Platform::Platform() : notificationCenter(std::make_shared<NotificationCenter>()) {}
Platform::~Platform() = default;

std::shared_ptr<Platform> Platform::installed() {
    const std::lock_guard lock(installMutex());
    return slot();
}

Platform* currentPlatform() {
    // Only this thread changes what the slot holds.
    return slot().get();
}

void Platform::install(std::shared_ptr<Platform> platform) {
    // What goes is dropped while it is still installed: teardown of shared objects may log or remove observers.
    if (const auto old = installed(); old && old != platform) {
        old->dropShared();
    }
    std::shared_ptr<Platform> previous = std::move(platform);
    const std::lock_guard lock(installMutex());
    std::swap(previous, slot());
}

void Platform::dropShared() {
    std::unordered_map<std::type_index, std::shared_ptr<void>> dropped;
    {
        const std::lock_guard lock(mutex_);
        dropped.swap(shared_);
    }
}

std::shared_ptr<void> Platform::sharedObject(std::type_index type, const std::function<std::shared_ptr<void>()>& make) {
    const std::lock_guard lock(mutex_);
    const auto found = shared_.find(type);
    if (found != shared_.end()) {
        return found->second;
    }
    auto object = make();
    shared_.emplace(type, object);
    return object;
}

}  // namespace ktr::platform
