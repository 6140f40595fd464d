#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "linux/net/HttpsClient.h"
#include "linux/net/ServiceCheck.h"

namespace ktr::linux_ {

/// A link with which somebody signs in once, as a service of one's own gives it: "https://HOST/me/in?link=…". Its
/// secret goes into the body of one request to its host, and nowhere else.
class SignInLink {
  public:
    /// None for anything else.
    static std::optional<SignInLink> read(const std::string& typed);

    /// With ":port" where that is not 443.
    const std::string& host() const { return host_; }

    struct Exchanged {
        ServiceCheck::Outcome outcome = ServiceCheck::Outcome::NothingAnswers;  ///< `Unknown`: it was spent, or is too
                                                                                ///< old
        std::string reason;  ///< in words for a log line, without anything private; empty when fine
        std::string person;
        std::string secret;
    };
    /// Spends it. Calls `done` once, never inside the call, on the network thread. The client outlives it. Any thread.
    void exchange(HttpsClient& client, const std::vector<std::string>& certificateFiles,
                  std::function<void(Exchanged)> done) const;

  private:
    SignInLink(std::string host, std::string secret) : host_(std::move(host)), secret_(std::move(secret)) {}

    std::string host_;
    std::string secret_;
};

}  // namespace ktr::linux_
