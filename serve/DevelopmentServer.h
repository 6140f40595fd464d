#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "serve/DevelopmentCertificates.h"
#include "serve/FaultScript.h"
#include "serve/LocationService.h"

namespace ktr::serve {

/// The development FriendLocationService on loopback, over HTTPS (TLS 1.2 or newer, HTTP/1.1). It answers on threads of
/// its own. What is public belongs to the thread that made it.
class DevelopmentServer {
  public:
    struct Setup {
        int port = 0;  ///< 0: a free one
        std::string personId;
        std::string token;
        FriendsFile friends;
        FaultScript faults;
        DevelopmentCertificates::Pair certificate;
        std::vector<std::string> maps = {};  ///< by which the service names what the friends file does not
        /// Gets one line a request, without handles, positions and credentials. Any thread, one call at a time.
        std::function<void(const std::string&)> report;
    };

    explicit DevelopmentServer(Setup setup);
    /// Stops.
    ~DevelopmentServer();
    DevelopmentServer(const DevelopmentServer&) = delete;
    DevelopmentServer& operator=(const DevelopmentServer&) = delete;

    /// Takes the port and begins to answer. Empty when done, else what failed.
    std::string start();
    /// Breaks off answers under way and returns when all threads have ended.
    void stop();
    /// After `start`.
    int port() const;

  private:
    class Server;
    std::unique_ptr<Server> server_;
};

}  // namespace ktr::serve
