#pragma once

#include <sys/stat.h>

#include <filesystem>
#include <string>

namespace ktr::documents {

/// What decides where a secret goes must not be anybody's to change: a file of this user or the administrator, that
/// nobody else may write, in folders of which the same is true all the way up; a folder with the sticky bit (/tmp) lets
/// nobody replace what is another's. Any thread; it looks at the disk.
class FileTrust {
  public:
    /// Why others could change an opened file: a reason with its remedy, or empty when they cannot.
    static std::string problemOf(const std::filesystem::path& file, const struct stat& facts);
    /// The same of a folder.
    static std::string problemOfFolder(const std::filesystem::path& folder);
};

}  // namespace ktr::documents
