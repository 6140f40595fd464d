#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "linux/net/HttpsClient.h"
#include "platform/base/Date.h"

namespace ktr::linux_ {

/// Asks a service for the places of nobody: what comes back tells whether it is there, is trusted, knows the person,
/// and what time it has. Nobody is shown, and nothing is changed.
class ServiceCheck {
  public:
    struct Account {
        std::string host;  ///< with ":port" where that is not 443
        std::string person;
        std::string secret;
        std::vector<std::string> certificateFiles;
        /// As `account.domains` of the configuration: who else may be asked when the service says so.
        std::optional<std::vector<std::string>> domains;
    };
    enum class Outcome {
        Fine,
        BadAddress,      ///< no host, or no person that can be named in a request
        NothingAnswers,  ///< no such name, no connection, or nothing within the time
        NotTrusted,      ///< it cannot prove to be the host
        Unknown,         ///< the service does not know person and secret together
        NoService,       ///< something else answers there
        Failing,         ///< the service says that it cannot help now
    };
    struct Result {
        Outcome outcome = Outcome::NothingAnswers;
        std::string reason;    ///< in words for a log line, without anything private; empty when fine
        double seconds = 0.0;  ///< until the answer
        /// How far this computer is ahead of the service, seconds; none where it does not tell its time.
        std::optional<double> ahead;
    };

    /// For everything together, seconds.
    static constexpr double kDeadline = 12.0;

    /// Calls `done` once, never inside the call, on the network thread. The client outlives it. Any thread.
    static void run(HttpsClient& client, const Account& account, std::function<void(Result)> done);
    /// What an answer tells.
    static Result of(const HttpsAnswer& answer, double seconds, platform::Date now);

    /// "brin.example" of what a person types for it: "https://Brin.example/". None for what is no secure address.
    static std::optional<std::string> hostOf(const std::string& typed);
};

}  // namespace ktr::linux_
