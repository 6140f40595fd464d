#pragma once

#include <filesystem>

namespace ktr::documents {

/// A lock between processes, held for as long as the object lives; a process that dies lets go of it. It lies in a file
/// of its own, since the file it protects is replaced again and again. Any thread; the constructor waits for its turn.
class FileLock {
  public:
    /// Creates the lock's file, mode 0600, when it is missing.
    explicit FileLock(const std::filesystem::path& file);
    ~FileLock();
    FileLock(const FileLock&) = delete;
    FileLock& operator=(const FileLock&) = delete;

    /// False when there can be no lock here: the folder is missing, read-only, or without locks.
    bool isHeld() const { return descriptor_ >= 0; }

  private:
    int descriptor_ = -1;
};

}  // namespace ktr::documents
