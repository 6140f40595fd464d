#pragma once

#include <filesystem>

namespace ktr::linux_ {

/// Where this program keeps its files, by the XDG base directory specification: a variable that is unset, empty or
/// holds a relative path counts as unset. Nothing is created. Any thread.
class XdgFolders {
  public:
    /// The user's own folder.
    static std::filesystem::path home();
    /// $XDG_CONFIG_HOME/ktr, else ~/.config/ktr.
    static std::filesystem::path config();
    /// $XDG_STATE_HOME/ktr, else ~/.local/state/ktr.
    static std::filesystem::path state();
    /// $XDG_CACHE_HOME/ktr, else ~/.cache/ktr.
    static std::filesystem::path cache();
    /// $XDG_DATA_HOME/ktr, else ~/.local/share/ktr.
    static std::filesystem::path data();
    /// KTR_CONFIG when it is set, else config.json in the configuration folder.
    static std::filesystem::path configurationFile();
};

}  // namespace ktr::linux_
