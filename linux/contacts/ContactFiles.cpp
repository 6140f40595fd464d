#include "linux/contacts/ContactFiles.h"

#include <QFileSystemWatcher>
#include <QTimer>
#include <filesystem>
#include <utility>

#include "linux/contacts/VCardReader.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

/// A tool that writes a folder of cards is given so long to write the next one, milliseconds.
constexpr int kQuiet = 300;

const platform::Log& log() {
    return platform::areaLog(platform::LogArea::Contacts);
}

}  // namespace

struct ContactFiles::State {
    std::shared_ptr<platform::MainLoop> mainLoop;
    std::unique_ptr<QFileSystemWatcher> watcher = std::make_unique<QFileSystemWatcher>();
    /// Runs out when a burst of changes is over.
    std::unique_ptr<QTimer> quiet = std::make_unique<QTimer>();
    Paths paths;
    std::function<void(Contacts)> changed;
    bool isReading = false;
    bool again = false;  ///< something changed while reading
};

std::optional<ContactFiles::Contacts> ContactFiles::read(const Paths& paths, std::string& error) {
    Contacts all;
    for (const std::string& path : paths) {
        auto read = VCardReader().read(path);
        for (const VCardReader::Problem& problem : read.problems) {
            // Where the mistake is belongs to whoever has to mend it: shown, unlike what stands in the card.
            log().write(platform::LogLevel::Error, "%@:%li: contact passed over: %@",
                        platform::FormatArgument(problem.file.string()).shown(), static_cast<long>(problem.line),
                        platform::FormatArgument(problem.message).shown());
        }
        if (read.error) {
            error = *read.error;
            return std::nullopt;
        }
        std::move(read.contacts.begin(), read.contacts.end(), std::back_inserter(all));
    }
    return all;
}

ContactFiles::ContactFiles(std::shared_ptr<platform::MainLoop> mainLoop) : state_(std::make_shared<State>()) {
    state_->mainLoop = std::move(mainLoop);
    state_->quiet->setSingleShot(true);
    state_->quiet->setInterval(kQuiet);
    const std::weak_ptr<State> weak = state_;
    const auto touched = [weak](const QString&) {
        if (const auto state = weak.lock()) {
            state->quiet->start();
        }
    };
    QObject::connect(state_->watcher.get(), &QFileSystemWatcher::fileChanged, state_->watcher.get(), touched);
    QObject::connect(state_->watcher.get(), &QFileSystemWatcher::directoryChanged, state_->watcher.get(), touched);
    QObject::connect(state_->quiet.get(), &QTimer::timeout, state_->quiet.get(), [weak] {
        if (const auto state = weak.lock()) {
            reload(state);
        }
    });
}

ContactFiles::~ContactFiles() {
    // Reading under way still holds the state; what belongs to this thread goes now.
    state_->watcher.reset();
    state_->quiet.reset();
    state_->changed = nullptr;
}

void ContactFiles::follow(const Paths& paths, std::function<void(Contacts)> changed) {
    state_->changed = std::move(changed);
    setPaths(paths);
}

void ContactFiles::setPaths(const Paths& paths) {
    state_->paths = paths;
    const QStringList known = state_->watcher->files() + state_->watcher->directories();
    if (!known.isEmpty()) {
        state_->watcher->removePaths(known);
    }
    watch(state_);
}

void ContactFiles::reload() {
    reload(state_);
}

void ContactFiles::watch(const std::shared_ptr<State>& state) {
    if (!state->watcher) {
        return;
    }
    // Editors replace files: the folder tells of the new one, the file of changes in place. Of a folder of cards each
    // file is watched for the latter.
    QStringList wanted;
    std::error_code failure;
    for (const std::string& path : state->paths) {
        const std::filesystem::path file(path);
        wanted << QString::fromStdString(path) << QString::fromStdString(file.parent_path().string());
        if (std::filesystem::is_directory(file, failure)) {
            // An operating system watches so many files for one user, and no more.
            constexpr int kMost = 1000;
            for (std::filesystem::directory_iterator at(file, failure), end; at != end && wanted.size() < kMost;
                 at.increment(failure)) {
                if (at->path().extension() == ".vcf") {
                    wanted << QString::fromStdString(at->path().string());
                }
            }
        }
    }
    const QStringList known = state->watcher->files() + state->watcher->directories();
    for (const QString& path : wanted) {
        if (!path.isEmpty() && !known.contains(path) && std::filesystem::exists(path.toStdString(), failure)) {
            state->watcher->addPath(path);
        }
    }
}

void ContactFiles::reload(const std::shared_ptr<State>& state) {
    if (state->isReading) {
        state->again = true;
        return;
    }
    state->isReading = true;
    // A loop waits for its background work when it is destroyed, and must not be destroyed by it.
    platform::MainLoop* const mainLoop = state->mainLoop.get();
    mainLoop->runInBackground([weak = std::weak_ptr<State>(state), mainLoop, paths = state->paths] {
        std::string error;
        auto contacts = std::make_shared<std::optional<Contacts>>(read(paths, error));
        mainLoop->post([weak, contacts, error, paths] {
            const auto later = weak.lock();
            if (!later) {
                return;
            }
            later->isReading = false;
            watch(later);
            const bool isPast = paths != later->paths;
            if (std::exchange(later->again, false) || isPast) {
                reload(later);
            } else if (!*contacts) {
                log().write(platform::LogLevel::Error, "the contacts stay as they were: %@",
                            platform::FormatArgument(error).shown());
            } else if (later->changed) {
                later->changed(std::move(**contacts));
            }
        });
    });
}

}  // namespace ktr::linux_
