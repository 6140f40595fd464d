#include "linux/device/FileWatch.h"

#include <sys/inotify.h>
#include <unistd.h>

#include <QSocketNotifier>
#include <array>
#include <cerrno>
#include <cstdint>
#include <mutex>
#include <set>
#include <system_error>
#include <utility>

#include "platform/base/Log.h"

namespace ktr::linux_ {

namespace {

// Editors replace files: the folders tell of the new file, the files of changes in place.
constexpr std::uint32_t kOfFile = IN_MODIFY | IN_ATTRIB | IN_MOVE_SELF | IN_DELETE_SELF;
constexpr std::uint32_t kOfFolder = IN_CREATE | IN_DELETE | IN_MOVE | IN_DELETE_SELF | IN_MOVE_SELF | IN_ONLYDIR;

void warn(const char* what, int number) {
    platform::platformLog().write(platform::LogLevel::Error, "files are not followed: %@: %@",
                                  platform::FormatArgument(std::string(what)),
                                  platform::FormatArgument(std::generic_category().message(number)));
}

}  // namespace

/// The system's side. Any thread.
class FileWatch::Events {
  public:
    Events() : descriptor_(inotify_init1(IN_NONBLOCK | IN_CLOEXEC)) {
        if (descriptor_ < 0) {
            warn("inotify", errno);
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
        bool isFolderNew = false;
        for (const std::filesystem::path& file : files) {
            add(file, kOfFile);
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

  private:
    /// Whether it is watched from now on and was not.
    bool add(const std::filesystem::path& path, std::uint32_t what) {
        if (path.empty() || descriptor_ < 0) {
            return false;
        }
        const int watch = inotify_add_watch(descriptor_, path.c_str(), what);
        if (watch < 0) {
            if (errno == ENOSPC) {
                warn(path.c_str(), errno);
            }
            return false;
        }
        // The system gives each another number, and the same one twice the same.
        const std::lock_guard<std::mutex> lock(mutex_);
        return known_.insert(watch).second;
    }

    const int descriptor_;
    std::mutex mutex_;
    std::set<int> known_;
};

FileWatch::FileWatch(std::function<void()> changed)
    : changed_(std::move(changed)), events_(std::make_shared<Events>()), aside_(*this) {
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
    aside_.run([events = events_, files = std::move(files), then = std::move(then)] {
        const bool isFolderNew = events->add(files);
        return [then, isFolderNew] {
            if (then) {
                then(isFolderNew);
            }
        };
    });
}

}  // namespace ktr::linux_
