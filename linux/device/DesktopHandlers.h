#pragma once

#include <string>

namespace ktr::linux_ {

/// The programs that the desktop's user has chosen for the schemes of URLs (freedesktop.org, "Association between MIME
/// types and applications"), through a library that is loaded with the first of them.
class DesktopHandlers {
  public:
    /// Has the program that is there for the URL's scheme open it; false, and a line in the log, when there is none. It
    /// waits for disk and bus: not on the main thread.
    static bool open(const std::string& url);
};

}  // namespace ktr::linux_
