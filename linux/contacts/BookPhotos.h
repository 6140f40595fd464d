#pragma once

#include <cstddef>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace ktr::linux_ {

/// An address book keeps photos in files of its own and names them in its cards. Any thread; it reads the disk.
class BookPhotos {
  public:
    /// A larger photo is left out; bytes.
    static constexpr std::size_t kLargest = std::size_t{8} << 20;

    /// The folders in which the desktop's address books keep photos, from the environment (XDG Base Directory
    /// Specification).
    static std::vector<std::filesystem::path> folders();

    /// The cards with each photo that is a file in one of these folders in its card; one that is elsewhere, or cannot
    /// be read, stays a name, which nobody follows.
    static std::string withPhotos(std::string_view cards, const std::vector<std::filesystem::path>& folders);
};

}  // namespace ktr::linux_
