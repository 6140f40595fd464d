#pragma once

#include <memory>
#include <string>

#include "tiles/MbtilesFile.h"

namespace ktr::tiles {

/// MBTiles files read with SQLite. A library of its own, so that who may never see such a file need not load SQLite.
class SqliteMbtiles {
  public:
    /// None, with a reason in `error`: missing, no regular file, no database, damaged, locked for writing, without
    /// tiles. Waits for the disk. Any thread; may throw what memory that is used up throws.
    static std::shared_ptr<MbtilesFile> open(const std::string& path, std::string& error);
};

}  // namespace ktr::tiles
