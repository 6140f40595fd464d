#pragma once

#include <string>

namespace ktr::linux_ {

/// The only symbol of libktr-handlers.so, of type `HandlersModuleEntry`: has the program that the desktop's user has
/// chosen for the URL's scheme open it. False, with a reason in `error`, when there is none or it cannot be started.
/// Nothing thrown leaves it. It waits for disk and bus: not on the main thread.
inline constexpr const char* kHandlersModuleEntry = "ktrOpenWithHandler";
using HandlersModuleEntry = bool (*)(const std::string& url, std::string& error);

}  // namespace ktr::linux_
