#pragma once

#include <sys/types.h>

#include <filesystem>
#include <string>
#include <string_view>

namespace ktr::documents {

/// Replaces a file as a whole: whoever opens it, and whatever happens to this process or the power, it holds either its
/// old bytes or its new ones. Any thread; it waits for the disk.
class AtomicFile {
  public:
    /// Writes to "FILE.new", brings that to the disk, renames it over the file and brings the folder to the disk. Empty
    /// when done, else one line that says what failed; the old file is untouched then. Two writers at a time need a
    /// FileLock between them. A symbolic link in the file's place is replaced; a folder, a pipe or a device
    /// there is refused.
    static std::string write(const std::filesystem::path& file, std::string_view bytes, mode_t mode = 0600);
    /// Makes the folder and those above it, its own mode 0700. Empty when it is there, else what failed.
    static std::string makeFolder(const std::filesystem::path& folder);
};

}  // namespace ktr::documents
