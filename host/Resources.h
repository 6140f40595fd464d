#pragma once

#include <filesystem>

namespace ktr::host {

/// The folder of what the program reads while it runs: images/ and localization/ stand in it. KTR_RESOURCES names
/// another one; else it is ../share/ktr from the program's own folder, in a build tree as in an installation.
std::filesystem::path resourceFolder();

}  // namespace ktr::host
