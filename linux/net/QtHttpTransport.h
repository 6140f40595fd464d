#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "linux/net/HttpsClient.h"
#include "linux/net/ServicePolicy.h"
#include "linux/net/TroubleLine.h"
#include "platform/client/HttpTransport.h"

namespace ktr::linux_ {

/// Sends commands as HttpsExchange does, each as one POST. Redirects are followed as ServicePolicy allows: 307 and 308,
/// https, at most five. What comes back is read off the main thread. Why a command failed is said in a line of the log.
class QtHttpTransport : public platform::HttpTransport {
  public:
    struct Settings {
        /// The host that the account names; none without an account, and then nothing is sent.
        std::optional<std::string> serviceHost;
        /// As ServicePolicy takes them.
        std::optional<std::vector<std::string>> domains;
        /// Files of certificates (PEM) that are trusted besides the system's. One that cannot be read is an error line
        /// in the log.
        std::vector<std::string> certificateFiles;
        bool operator==(const Settings&) const = default;
    };

    /// `settings` is asked on the main thread at each command, so that a new account counts from then on. Without a
    /// thread it has one of its own.
    explicit QtHttpTransport(std::function<Settings()> settings, std::shared_ptr<NetworkThread> thread = nullptr);
    /// Commands under way end with `Cancelled`.
    ~QtHttpTransport() override;
    QtHttpTransport(const QtHttpTransport&) = delete;
    QtHttpTransport& operator=(const QtHttpTransport&) = delete;

    void send(const platform::HttpRequest& request, Completion completion) override;

  private:
    void prepare();

    std::function<Settings()> settings_;
    std::optional<Settings> current_;
    ServicePolicy policy_{"", std::nullopt};
    /// Used on the network thread.
    TroubleLine trouble_{platform::LogArea::Net, "A command to %@ failed: %@"};
    /// Goes first: what it ends still says why.
    HttpsClient client_;
};

}  // namespace ktr::linux_
