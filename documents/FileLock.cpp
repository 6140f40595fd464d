#include "documents/FileLock.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <thread>

#include "documents/FileSteps.h"

namespace ktr::documents {

FileLock::FileLock(const std::filesystem::path& file, std::chrono::milliseconds longestWait) {
    // Not waiting: what stands in the lock's place may be a pipe.
    descriptor_ = FileSteps::open(file, O_RDWR | O_CREAT | O_NOFOLLOW | O_NONBLOCK, 0600);
    if (descriptor_ < 0) {
        problem_ = std::strerror(errno);
        return;
    }
    struct stat facts {};
    if (::fstat(descriptor_, &facts) != 0) {
        problem_ = std::strerror(errno);
    } else if (!S_ISREG(facts.st_mode)) {
        problem_ = "what lies in the lock's place is no file";
    } else {
        lock(longestWait);
    }
    if (!problem_.empty()) {
        ::close(descriptor_);
        descriptor_ = -1;
    }
}

void FileLock::lock(std::chrono::milliseconds longestWait) {
    constexpr std::chrono::milliseconds kBetweenTries{5};
    const auto end = std::chrono::steady_clock::now() + longestWait;
    while (::flock(descriptor_, LOCK_EX | LOCK_NB) != 0) {
        if (errno != EWOULDBLOCK && errno != EINTR) {
            problem_ = std::strerror(errno);
            return;
        }
        if (std::chrono::steady_clock::now() >= end) {
            problem_ = "another process holds the lock";
            return;
        }
        std::this_thread::sleep_for(kBetweenTries);
    }
}

FileLock::~FileLock() {
    if (descriptor_ >= 0) {
        ::close(descriptor_);
    }
}

}  // namespace ktr::documents
