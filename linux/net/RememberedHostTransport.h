#pragma once

#include <memory>
#include <string>

#include "platform/base/Preferences.h"
#include "platform/client/HttpTransport.h"

namespace ktr::linux_ {

/// Hands commands on, and makes the host that redirects led to be forgotten when it can no longer serve: when it fails
/// its TLS check, answers 401, or is one that the account does not allow (any more). The command fails; the next one
/// tries the account's own host.
class RememberedHostTransport : public platform::HttpTransport {
  public:
    /// `domain` and `key`: where the plugin remembers the host.
    RememberedHostTransport(std::shared_ptr<platform::HttpTransport> next,
                            std::shared_ptr<platform::Preferences> preferences, std::string domain = "org.ktr.snippets",
                            std::string key = "RedirectedHostKey");
    ~RememberedHostTransport() override;

    void send(const platform::HttpRequest& request, Completion completion) override;

  private:
    std::shared_ptr<platform::HttpTransport> next_;
    std::shared_ptr<platform::Preferences> preferences_;
    std::string domain_;
    std::string key_;
};

}  // namespace ktr::linux_
