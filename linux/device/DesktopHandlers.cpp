#include "linux/device/DesktopHandlers.h"

#include "linux/device/HandlersModule.h"
#include "linux/device/LoadableModule.h"
#include "platform/base/LogArea.h"

namespace ktr::linux_ {

bool DesktopHandlers::open(const std::string& url) {
    struct Module {
        HandlersModuleEntry open = nullptr;
        std::string error;
    };
    static const Module loaded = [] {
        Module made;
        made.open = reinterpret_cast<HandlersModuleEntry>(
            LoadableModule::entry("libktr-handlers.so", kHandlersModuleEntry, made.error));
        return made;
    }();
    std::string error = loaded.error;
    if (loaded.open != nullptr && loaded.open(url, error)) {
        return true;
    }
    platform::areaLog(platform::LogArea::Host).line("%@ is not opened: %@", url, error);
    return false;
}

}  // namespace ktr::linux_
