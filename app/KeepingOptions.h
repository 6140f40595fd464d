#pragma once

#include <string>

namespace ktr::app {

/// What `ktr config` is asked for.
struct ConfigOptions {
    enum class Action { Get, Set, Unset, List };
    Action action = Action::List;
    std::string name;   ///< of a setting, with dots
    std::string value;  ///< as it was typed
    bool json = false;
};

/// What `ktr doctor` is asked for.
struct DoctorOptions {
    bool json = false;
};

}  // namespace ktr::app
