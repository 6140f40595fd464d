#include "linux/configuration/ConfigurationWatcher.h"

#include <QFileSystemWatcher>
#include <QString>
#include <QStringList>
#include <filesystem>
#include <utility>

namespace ktr::linux_ {

struct ConfigurationWatcher::State {
    std::shared_ptr<ConfiguredAccountStore> store;
    std::shared_ptr<platform::MainLoop> mainLoop;
    std::function<void()> changed;
    std::function<void()> done;  ///< of the first reading
    std::unique_ptr<QFileSystemWatcher> watcher;
    bool reading = false;
    bool again = false;  ///< something changed while reading
};

ConfigurationWatcher::ConfigurationWatcher(std::shared_ptr<ConfiguredAccountStore> store,
                                           std::shared_ptr<platform::MainLoop> mainLoop, std::function<void()> changed)
    : state_(std::make_shared<State>()) {
    state_->store = std::move(store);
    state_->mainLoop = std::move(mainLoop);
    state_->changed = std::move(changed);
    state_->watcher = std::make_unique<QFileSystemWatcher>();
    const std::weak_ptr<State> weak = state_;
    const auto touched = [weak](const QString&) {
        if (const auto state = weak.lock()) {
            reload(state);
        }
    };
    QObject::connect(state_->watcher.get(), &QFileSystemWatcher::fileChanged, state_->watcher.get(), touched);
    QObject::connect(state_->watcher.get(), &QFileSystemWatcher::directoryChanged, state_->watcher.get(), touched);
    watch(*state_);
}

ConfigurationWatcher::~ConfigurationWatcher() {
    // A reading under way may still hold the state; it must not call back, and the watcher belongs to this thread.
    state_->watcher.reset();
    state_->changed = nullptr;
    state_->done = nullptr;
}

void ConfigurationWatcher::start(std::function<void()> done) {
    state_->done = std::move(done);
    reload(state_);
}

void ConfigurationWatcher::reload() {
    reload(state_);
}

bool ConfigurationWatcher::watch(State& state) {
    if (!state.watcher) {
        return false;
    }
    bool isFolderNew = false;
    const QStringList known = state.watcher->files() + state.watcher->directories();
    const auto add = [&](const std::filesystem::path& path) {
        const QString name = QString::fromStdString(path.string());
        return !known.contains(name) && state.watcher->addPath(name);
    };
    // Editors replace files: the folders tell of the new file, the files of changes in place.
    for (const auto& file : {state.store->configurationFile(), state.store->tokenFile()}) {
        std::error_code failure;
        if (!file.empty() && std::filesystem::exists(file, failure)) {
            add(file);
        }
        if (!file.empty() && std::filesystem::is_directory(file.parent_path(), failure)) {
            isFolderNew = add(file.parent_path()) || isFolderNew;
        }
    }
    return isFolderNew;
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
    // Nobody has looked whether anything changed there since it was read.
    state->again = watch(*state) || state->again;
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
