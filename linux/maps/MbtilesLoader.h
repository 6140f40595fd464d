#pragma once

#include <memory>
#include <string>

#include "tiles/MbtilesFile.h"

namespace ktr::linux_ {

/// Opens MBTiles files with SQLite, which is loaded with the first of them.
class MbtilesLoader {
  public:
    /// None, with a reason in `error`: missing, no database, damaged, locked for writing, without tiles. Waits for the
    /// disk: not on the main thread.
    static std::shared_ptr<tiles::MbtilesFile> open(const std::string& path, std::string& error);
    /// Sees to it that a file finds its tiles by an index: where it has none, a copy with one is made at `to`, which is
    /// not there yet. For a file that `open` has taken. Empty when done, else what failed. Waits for the disk: not on
    /// the main thread of a window.
    static std::string index(const std::string& from, const std::string& to, bool& isCopied);
};

}  // namespace ktr::linux_
