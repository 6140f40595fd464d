#pragma once

#include <array>
#include <filesystem>
#include <optional>
#include <string>

namespace ktr::linux_ {

/// How large KDE's users want their texts: the size of its general font, over the usual ten points, and its own
/// resolution for fonts, over the usual 96 dots an inch. Any thread; it reads the disk.
class KdeFonts {
  public:
    static constexpr std::array kFiles = {"kdeglobals", "kcmfontsrc"};

    /// 1 is the usual size. None where neither file says anything usable. The folder is that of the user's
    /// configuration files.
    static std::optional<double> textScale(const std::filesystem::path& folder);
    /// The same of what stands in the two files.
    static std::optional<double> textScale(const std::string& globals, const std::string& fonts);
};

}  // namespace ktr::linux_
