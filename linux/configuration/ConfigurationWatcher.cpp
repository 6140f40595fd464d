#include "linux/configuration/ConfigurationWatcher.h"

#include <utility>

#include "linux/device/FileWatch.h"

namespace ktr::linux_ {

struct ConfigurationWatcher::State {
    std::shared_ptr<ConfiguredAccountStore> store;
    std::shared_ptr<platform::MainLoop> mainLoop;
    std::function<void()> changed;
    std::function<void()> done;  ///< of the first reading
    std::unique_ptr<FileWatch> watch;
    bool reading = false;
    bool again = false;  ///< something changed while reading

    FileWatch::Files files() const {
        FileWatch::Files files{store->configurationFile()};
        if (const auto token = store->tokenFile(); !token.empty()) {
            files.push_back(token);
        }
        return files;
    }
};

ConfigurationWatcher::ConfigurationWatcher(std::shared_ptr<ConfiguredAccountStore> store,
                                           std::shared_ptr<platform::MainLoop> mainLoop, std::function<void()> changed)
    : state_(std::make_shared<State>()) {
    state_->store = std::move(store);
    state_->mainLoop = std::move(mainLoop);
    state_->changed = std::move(changed);
    const std::weak_ptr<State> weak = state_;
    state_->watch = std::make_unique<FileWatch>([weak] {
        if (const auto state = weak.lock()) {
            reload(state);
        }
    });
}

ConfigurationWatcher::~ConfigurationWatcher() {
    // A reading under way may still hold the state; it must not call back, and the watcher belongs to this thread.
    state_->watch.reset();
    state_->changed = nullptr;
    state_->done = nullptr;
}

void ConfigurationWatcher::start(std::function<void()> done) {
    state_->done = std::move(done);
    // It watches before it reads, so that no change falls between the two.
    state_->watch->watch(state_->files(), [weak = std::weak_ptr<State>(state_)](bool) {
        if (const auto state = weak.lock()) {
            reload(state);
        }
    });
}

void ConfigurationWatcher::reload() {
    reload(state_);
}

void ConfigurationWatcher::watch(const std::shared_ptr<State>& state) {
    if (!state->watch) {
        return;
    }
    state->watch->watch(state->files(), [weak = std::weak_ptr<State>(state)](bool isFolderNew) {
        // Nobody has looked whether anything changed there since it was read.
        if (const auto later = weak.lock(); later && isFolderNew) {
            reload(later);
        }
    });
}

void ConfigurationWatcher::reload(const std::shared_ptr<State>& state) {
    if (state->reading) {
        state->again = true;
        return;
    }
    state->reading = true;
    const auto store = state->store;
    // A loop waits for its background work when it is destroyed, and must not be destroyed by it.
    platform::MainLoop* const mainLoop = state->mainLoop.get();
    const std::weak_ptr<State> weak = state;
    mainLoop->runInBackground([store, mainLoop, weak] {
        store->read();
        mainLoop->post([weak] {
            if (const auto later = weak.lock()) {
                taken(later);
            }
        });
    });
}

void ConfigurationWatcher::taken(const std::shared_ptr<State>& state) {
    state->reading = false;
    const bool isNew = state->store->take();
    watch(state);
    if (const auto done = std::exchange(state->done, nullptr)) {
        done();
    } else if (isNew && state->changed) {
        state->changed();
    }
    if (std::exchange(state->again, false)) {
        reload(state);
    }
}

}  // namespace ktr::linux_
