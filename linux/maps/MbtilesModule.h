#pragma once

#include <memory>
#include <string>

#include "tiles/MbtilesFile.h"

namespace ktr::linux_ {

/// A symbol of libktr-mbtiles.so, of type `MbtilesModuleEntry`: opens an MBTiles file with SQLite into `file`.
/// False, with a reason in `error`, when it is no such thing or cannot be read now. Nothing thrown leaves it. Any
/// thread.
inline constexpr const char* kMbtilesModuleEntry = "ktrOpenMbtiles";
using MbtilesModuleEntry = bool (*)(const std::string& path, std::shared_ptr<tiles::MbtilesFile>& file,
                                    std::string& error);

/// The other symbol, of type `MbtilesKeepEntry`: whether a file finds its tiles by an index; where it does not, a copy
/// of it that does is made at `to`. False, with a reason in `error`, when neither can be done. Nothing thrown leaves
/// it. Any thread.
inline constexpr const char* kMbtilesKeepEntry = "ktrIndexMbtiles";
using MbtilesKeepEntry = bool (*)(const std::string& from, const std::string& to, bool& isCopied, std::string& error);

}  // namespace ktr::linux_
