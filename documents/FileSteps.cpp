#include "documents/FileSteps.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <system_error>

namespace ktr::documents {

namespace {

int writeAll(int descriptor, std::string_view bytes) {
    while (!bytes.empty()) {
        const ssize_t count = ::write(descriptor, bytes.data(), bytes.size());
        if (count < 0 && errno != EINTR) {
            return errno;
        }
        bytes.remove_prefix(count < 0 ? 0 : static_cast<std::size_t>(count));
    }
    return 0;
}

int sync(int descriptor) {
    int result = 0;
    do {
        result = ::fsync(descriptor);
    } while (result != 0 && errno == EINTR);
    return result == 0 ? 0 : errno;
}

int copyAll(int from, int to) {
    std::string block(std::size_t{1} << 18, '\0');
    for (;;) {
        const ssize_t count = ::read(from, block.data(), block.size());
        if (count == 0 || (count < 0 && errno != EINTR)) {
            return count == 0 ? 0 : errno;
        }
        const int failure = count < 0 ? 0 : writeAll(to, {block.data(), static_cast<std::size_t>(count)});
        if (failure != 0) {
            return failure;
        }
    }
}

/// What was written comes to the disk, or goes.
int finish(int descriptor, int failure, const std::filesystem::path& file) {
    if (failure == 0) {
        failure = sync(descriptor);
    }
    // Some file systems report a full disk only here. The descriptor is gone whatever is said.
    if (::close(descriptor) != 0 && failure == 0 && errno != EINTR) {
        failure = errno;
    }
    if (failure != 0) {
        ::unlink(file.c_str());
    }
    return failure;
}

int openNew(const std::filesystem::path& file, mode_t mode) {
    return FileSteps::open(file, O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW, mode);
}

}  // namespace

int FileSteps::open(const std::filesystem::path& file, int flags, mode_t mode) {
    int descriptor = -1;
    do {
        descriptor = ::open(file.c_str(), flags | O_CLOEXEC, mode);
    } while (descriptor < 0 && errno == EINTR);
    return descriptor;
}

int FileSteps::writeNew(const std::filesystem::path& file, std::string_view bytes, mode_t mode) {
    const int descriptor = openNew(file, mode);
    return descriptor < 0 ? errno : finish(descriptor, writeAll(descriptor, bytes), file);
}

int FileSteps::copyNew(const std::filesystem::path& from, const std::filesystem::path& to, mode_t mode) {
    const int source = open(from, O_RDONLY);
    if (source < 0) {
        return errno;
    }
    const int descriptor = openNew(to, mode);
    const int failure = descriptor < 0 ? errno : finish(descriptor, copyAll(source, descriptor), to);
    ::close(source);
    return failure;
}

int FileSteps::syncFolder(const std::filesystem::path& folder) {
    const int descriptor = open(folder, O_RDONLY | O_DIRECTORY);
    if (descriptor < 0) {
        return errno;
    }
    const int failure = sync(descriptor);
    ::close(descriptor);
    // Not every file system can; those that cannot have nothing to bring there.
    return failure == EINVAL || failure == ENOTSUP ? 0 : failure;
}

std::filesystem::path FileSteps::absolute(const std::filesystem::path& file) {
    std::error_code gone;
    auto whole = std::filesystem::absolute(file, gone);
    return gone ? file : whole;
}

std::filesystem::path FileSteps::folderOf(const std::filesystem::path& file) {
    return file.has_parent_path() ? file.parent_path() : std::filesystem::path(".");
}

std::string FileSteps::sentence(const std::filesystem::path& file, const char* what, int failure) {
    return file.string() + ": cannot be " + what + ": " + std::strerror(failure);
}

}  // namespace ktr::documents
