#pragma once

#include <chrono>
#include <filesystem>
#include <string>

namespace ktr::documents {

/// A lock between processes, held for as long as the object lives; a process that dies lets go of it. It lies in a file
/// of its own, since the file it protects is replaced again and again. Any thread; the constructor waits for its turn,
/// but not for ever: whoever holds a lock longer is stuck.
class FileLock {
  public:
    static constexpr std::chrono::milliseconds kLongestWait{5000};

    /// Creates the lock's file, mode 0600, when it is missing.
    explicit FileLock(const std::filesystem::path& file, std::chrono::milliseconds longestWait = kLongestWait);
    ~FileLock();
    FileLock(const FileLock&) = delete;
    FileLock& operator=(const FileLock&) = delete;

    /// False when there can be no lock here: the folder is missing, read-only or without locks, something else is in
    /// the lock's place, or another process did not let go in time.
    bool isHeld() const { return descriptor_ >= 0; }
    /// Why it is not held, without the file's name.
    const std::string& problem() const { return problem_; }

  private:
    void lock(std::chrono::milliseconds longestWait);

    int descriptor_ = -1;
    std::string problem_;
};

}  // namespace ktr::documents
