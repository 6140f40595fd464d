#pragma once

#include <string>

namespace ktr::server {

/// An administrator who works on the folder of a service that another user runs becomes that user first: no file there
/// gets another owner, and what that user may have put there is read with that user's rights. All that is kept is to
/// find the way, since systemd hides such folders behind one of its own (/var/lib/private). Nothing happens to anybody
/// else, nor without a folder. Empty when done, else what failed. Before the first thread.
std::string becomeOwnerOf(const std::string& folder);

}  // namespace ktr::server
