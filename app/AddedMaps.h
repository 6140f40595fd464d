#pragma once

#include <cstdint>
#include <filesystem>
#include <string>
#include <variant>
#include <vector>

namespace ktr::app {

/// The maps of one's own: links, or copies with an index, in the folder of maps, which open windows watch. Any thread;
/// it waits for the disk.
class AddedMaps {
  public:
    struct Map {
        std::filesystem::path place;  ///< in the folder of maps
        std::string name;             ///< see `nameOf`
        std::uintmax_t bytes = 0;     ///< 0: it is not there any more
    };

    /// By name. What several maps are called is followed by the names of their files.
    static std::vector<Map> list();
    /// What the map says that it is called, as a short line; the file's name without its ending where it says nothing
    /// or cannot be read.
    static std::string nameOf(const std::filesystem::path& place);

    struct Problem {
        std::string why;  ///< one line
    };
    /// Checks a file with a map, and has it drawn from then on. What it covers, in a line.
    static std::variant<std::string, Problem> add(const std::string& file);
    /// Empty when done, else one line. The file that a link leads to stays as it is.
    static std::string remove(const std::filesystem::path& place);
};

}  // namespace ktr::app
