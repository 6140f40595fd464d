#pragma once

#include <vector>

namespace ktr::server {

/// What the service manager (systemd) and this process say to each other; nothing where there is none. Any thread.
class ServiceManager {
  public:
    /// The sockets that it made for this process; asked once.
    static std::vector<int> takeSockets();
    /// Requests are answered from now on.
    static void tellReady();
    static void tellStopping();
    /// All is well, for those that end a process which has not said so for a while.
    static void tellAlive();
};

}  // namespace ktr::server
