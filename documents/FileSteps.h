#pragma once

#include <sys/types.h>

#include <filesystem>
#include <string>
#include <string_view>

namespace ktr::documents {

/// The steps of replacing a file, each of which gives 0 or the errno of its failure where it does not say otherwise.
/// Any thread; they wait for the disk.
class FileSteps {
  public:
    /// Makes a file that was not there, writes all bytes and brings them to the disk. What a failure leaves is removed.
    static int writeNew(const std::filesystem::path& file, std::string_view bytes, mode_t mode);
    /// The same with the bytes of another file, however many they are. What is there already stays.
    static int copyNew(const std::filesystem::path& from, const std::filesystem::path& to, mode_t mode);
    /// Brings the names in a folder to the disk.
    static int syncFolder(const std::filesystem::path& folder);
    /// `open`, closed in programs that are started later, and again where a signal came between. A descriptor, or -1
    /// and errno.
    static int open(const std::filesystem::path& file, int flags, mode_t mode = 0);
    /// From the working folder on; as it stands where that has gone.
    static std::filesystem::path absolute(const std::filesystem::path& file);
    static std::filesystem::path folderOf(const std::filesystem::path& file);
    /// "dinner.png: cannot be written: No space left on device".
    static std::string sentence(const std::filesystem::path& file, const char* what, int failure);
};

}  // namespace ktr::documents
