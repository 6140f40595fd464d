#pragma once

#include <string>

namespace ktr::tiles {

/// Whether an MBTiles file finds a tile without looking at all of them, and a copy that does. With SQLite, in the
/// library of its own. Waits for the disk. Any thread.
class MbtilesIndex {
  public:
    enum class State { Indexed, Unindexed, Unreadable };

    static State stateOf(const std::string& path);
    /// Copies the file and gives the copy an index. Empty when done, else what failed; nothing is left behind then.
    static std::string copyIndexed(const std::string& from, const std::string& to);
};

}  // namespace ktr::tiles
