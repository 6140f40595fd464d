#include "documents/AtomicFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>

namespace ktr::documents {

namespace {

/// Each step gives 0 or the errno of its failure.
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

int writeNew(const std::filesystem::path& file, std::string_view bytes, mode_t mode) {
    // What a process that was killed left there is not ours to continue: begin anew.
    if (::unlink(file.c_str()) != 0 && errno != ENOENT) {
        return errno;
    }
    const int descriptor = ::open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC | O_NOFOLLOW, mode);
    if (descriptor < 0) {
        return errno;
    }
    int failure = writeAll(descriptor, bytes);
    if (failure == 0 && ::fsync(descriptor) != 0) {
        failure = errno;
    }
    // Some file systems report a full disk only here.
    if (::close(descriptor) != 0 && failure == 0) {
        failure = errno;
    }
    return failure;
}

int syncFolder(const std::filesystem::path& folder) {
    const int descriptor = ::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (descriptor < 0) {
        return errno;
    }
    const int failure = ::fsync(descriptor) == 0 ? 0 : errno;
    ::close(descriptor);
    // Not every file system can; those that cannot have nothing to bring there.
    return failure == EINVAL || failure == ENOTSUP ? 0 : failure;
}

std::string sentence(const std::filesystem::path& file, const char* what, int failure) {
    return file.string() + ": cannot be " + what + ": " + std::strerror(failure);
}

}  // namespace

std::string AtomicFile::write(const std::filesystem::path& file, std::string_view bytes, mode_t mode) {
    std::filesystem::path fresh = file;
    fresh += ".new";
    if (const int failure = writeNew(fresh, bytes, mode); failure != 0) {
        ::unlink(fresh.c_str());
        return sentence(file, "written", failure);
    }
    if (::rename(fresh.c_str(), file.c_str()) != 0) {
        const int failure = errno;
        ::unlink(fresh.c_str());
        return sentence(file, "replaced", failure);
    }
    const int failure = syncFolder(file.has_parent_path() ? file.parent_path() : std::filesystem::path("."));
    return failure == 0 ? "" : sentence(file, "brought to the disk", failure);
}

std::string AtomicFile::makeFolder(const std::filesystem::path& folder) {
    std::error_code failure;
    const std::filesystem::path above = folder.parent_path();
    if (!above.empty()) {
        std::filesystem::create_directories(above, failure);
    }
    if (::mkdir(folder.c_str(), 0700) == 0) {
        return "";
    }
    const int reason = errno;
    if (reason == EEXIST && std::filesystem::is_directory(folder, failure)) {
        return "";
    }
    return sentence(folder, "made", reason);
}

}  // namespace ktr::documents
