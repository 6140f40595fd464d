#include "linux/configuration/ConfigurationWatcher.h"

#include <QFileSystemWatcher>
#include <QString>
#include <QStringList>
#include <filesystem>

namespace ktr::linux_ {

struct ConfigurationWatcher::State {
    std::shared_ptr<ConfiguredAccountStore> store;
    std::shared_ptr<platform::MainLoop> mainLoop;
    std::function<void()> changed;
    std::unique_ptr<QFileSystemWatcher> watcher;
    bool loading = false;
    bool again = false;  ///< something changed while loading
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
    watch(state_);
}

ConfigurationWatcher::~ConfigurationWatcher() {
    // A load under way still holds the state; it must not call back, and the watcher belongs to this thread.
    state_->watcher.reset();
    state_->changed = nullptr;
}

void ConfigurationWatcher::reload() {
    reload(state_);
}

void ConfigurationWatcher::watch(const std::shared_ptr<State>& state) {
    if (!state->watcher) {
        return;
    }
    // Editors replace files: the folders tell of the new file, the files of changes in place.
    QStringList paths;
    for (const auto& file : {state->store->configurationFile(), state->store->tokenFile()}) {
        std::error_code failure;
        if (!file.empty() && std::filesystem::exists(file, failure)) {
            paths << QString::fromStdString(file.string());
        }
        if (!file.empty() && std::filesystem::is_directory(file.parent_path(), failure)) {
            paths << QString::fromStdString(file.parent_path().string());
        }
    }
    const QStringList known = state->watcher->files() + state->watcher->directories();
    for (const QString& path : paths) {
        if (!known.contains(path)) {
            state->watcher->addPath(path);
        }
    }
}

void ConfigurationWatcher::reload(const std::shared_ptr<State>& state) {
    if (state->loading) {
        state->again = true;
        return;
    }
    state->loading = true;
    const auto store = state->store;
    // A loop waits for its background work when it is destroyed, and must not be destroyed by it.
    platform::MainLoop* const mainLoop = state->mainLoop.get();
    const std::weak_ptr<State> weak = state;
    mainLoop->runInBackground([store, mainLoop, weak] {
        const bool changed = store->load();
        mainLoop->post([weak, changed] {
            const auto later = weak.lock();
            if (!later) {
                return;
            }
            later->loading = false;
            watch(later);
            if (changed && later->changed) {
                later->changed();
            }
            if (later->again) {
                later->again = false;
                reload(later);
            }
        });
    });
}

}  // namespace ktr::linux_
