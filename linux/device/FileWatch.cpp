#include "linux/device/FileWatch.h"

#include <sys/inotify.h>
#include <sys/stat.h>
#include <unistd.h>

#include <QSocketNotifier>
#include <array>
#include <cerrno>
#include <cstdint>
#include <map>
#include <mutex>
#include <set>
#include <system_error>
#include <tuple>
#include <utility>

#include "platform/base/Log.h"

namespace ktr::linux_ {

namespace {

// Editors replace files: the folders tell of the new file, the files of changes in place.
// A folder among the files is followed for whether it is there: what is written in it is another's matter.
constexpr std::uint32_t kOfFile = IN_MODIFY | IN_ATTRIB | IN_MOVE_SELF | IN_DELETE_SELF;
constexpr std::uint32_t kOfFolderItself = IN_MOVE_SELF | IN_DELETE_SELF | IN_ONLYDIR;
constexpr std::uint32_t kOfFolder = IN_CREATE | IN_DELETE | IN_MOVE | IN_DELETE_SELF | IN_MOVE_SELF | IN_ONLYDIR;

void note(const char* what, int number) {
    // Nobody misses anything: what changes is noticed some seconds later.
    platform::platformLog().write(platform::LogLevel::Info, "files are looked at now and then, not followed: %@: %@",
                                  platform::FormatArgument(std::string(what)),
                                  platform::FormatArgument(std::generic_category().message(number)));
}

/// What differs once a file or a folder has become another; all zero where there is none.
using Stamp = std::tuple<ino_t, off_t, time_t, long, time_t, long>;

Stamp stampOf(const std::filesystem::path& path) {
    struct stat found {};
    if (::stat(path.c_str(), &found) != 0) {
        return {};
    }
    return {found.st_ino,          found.st_size,        found.st_mtim.tv_sec,
            found.st_mtim.tv_nsec, found.st_ctim.tv_sec, found.st_ctim.tv_nsec};
}

}  // namespace

/// The system's side. Any thread.
class FileWatch::Events {
  public:
    Events() : descriptor_(inotify_init1(IN_NONBLOCK | IN_CLOEXEC)) {
        if (descriptor_ < 0) {
            note("inotify", errno);
        }
    }
    ~Events() {
        if (descriptor_ >= 0) {
            ::close(descriptor_);
        }
    }
    Events(const Events&) = delete;
    Events& operator=(const Events&) = delete;

    int descriptor() const { return descriptor_; }
    /// Whether one of the folders is new.
    bool add(const Files& files) {
        const std::lock_guard<std::mutex> lock(mutex_);
        bool isFolderNew = false;
        for (const std::filesystem::path& file : files) {
            std::error_code failed;
            add(file, std::filesystem::is_directory(file, failed) ? kOfFolderItself : kOfFile);
            isFolderNew = add(file.parent_path(), kOfFolder) || isFolderNew;
        }
        return isFolderNew;
    }
    /// Whether there was anything to take.
    bool take() const {
        std::array<char, 4096> events{};
        bool any = false;
        while (::read(descriptor_, events.data(), events.size()) > 0) {
            any = true;
        }
        return any;
    }
    /// Whether there is something that has to be looked at.
    bool mustLook() {
        const std::lock_guard<std::mutex> lock(mutex_);
        return !lookedAt_.empty();
    }
    /// Whether something became another since.
    bool look() {
        const std::lock_guard<std::mutex> lock(mutex_);
        bool any = false;
        for (auto& [path, stamp] : lookedAt_) {
            const Stamp now = stampOf(path);
            any = any || now != stamp;
            stamp = now;
        }
        return any;
    }

  private:
    /// Whether it is followed from now on and was not.
    bool add(const std::filesystem::path& path, std::uint32_t what) {
        if (path.empty()) {
            return false;
        }
        if (descriptor_ < 0) {
            return addToLookedAt(path);
        }
        // A folder that is followed for what is in it may be one of the files as well: neither takes the other's place.
        const int watch = inotify_add_watch(descriptor_, path.c_str(), what | IN_MASK_ADD);
        if (watch >= 0) {
            // The system gives each another number, and the same one twice the same.
            return known_.insert(watch).second;
        }
        if (errno != ENOSPC) {
            return false;
        }
        if (lookedAt_.empty()) {
            note(path.c_str(), ENOSPC);
        }
        return addToLookedAt(path);
    }
    bool addToLookedAt(const std::filesystem::path& path) {
        const Stamp now = stampOf(path);
        const auto [entry, isNew] = lookedAt_.try_emplace(path, now);
        if (isNew) {
            return now != Stamp{};
        }
        // What has become another since is told when it is looked at; what was not there has nothing to be told of.
        return entry->second == Stamp{} && std::exchange(entry->second, now) != now;
    }

    const int descriptor_;
    std::mutex mutex_;
    std::set<int> known_;
    std::map<std::filesystem::path, Stamp> lookedAt_;
};

FileWatch::FileWatch(std::function<void()> changed, std::chrono::milliseconds everySoOften)
    : changed_(std::move(changed)), events_(std::make_shared<Events>()), aside_(*this) {
    looks_.setSingleShot(true);
    looks_.setInterval(everySoOften);
    connect(&looks_, &QTimer::timeout, this, [this] { look(); });
    if (events_->descriptor() >= 0) {
        notifier_ = std::make_unique<QSocketNotifier>(events_->descriptor(), QSocketNotifier::Read);
        connect(notifier_.get(), &QSocketNotifier::activated, this, [this] {
            if (events_->take()) {
                changed_();
            }
        });
    }
}

FileWatch::~FileWatch() = default;

void FileWatch::watch(Files files, std::function<void(bool isFolderNew)> then) {
    aside_.run([this, events = events_, files = std::move(files), then = std::move(then)] {
        const bool isFolderNew = events->add(files);
        return [this, then, isFolderNew, mustLook = events->mustLook()] {
            if (mustLook && !looks_.isActive()) {
                looks_.start();
            }
            if (then) {
                then(isFolderNew);
            }
        };
    });
}

void FileWatch::look() {
    aside_.run([this, events = events_] {
        return [this, isOther = events->look()] {
            // Only now: a disk that does not answer is asked once.
            looks_.start();
            if (isOther) {
                changed_();
            }
        };
    });
}

}  // namespace ktr::linux_
