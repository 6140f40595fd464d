#pragma once

#include <memory>
#include <string>

#include "tiles/MbtilesFile.h"

namespace ktr::linux_ {

/// The only symbol of libktr-mbtiles.so, of type `MbtilesModuleEntry`: opens an MBTiles file with SQLite into `file`.
/// False, with a reason in `error`, when it is no such thing or cannot be read now. Nothing thrown leaves it. Any
/// thread.
inline constexpr const char* kMbtilesModuleEntry = "ktrOpenMbtiles";
using MbtilesModuleEntry = bool (*)(const std::string& path, std::shared_ptr<tiles::MbtilesFile>& file,
                                    std::string& error);

}  // namespace ktr::linux_
