#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "platform/base/Bundle.h"
#include "platform/base/Preferences.h"
#include "platform/client/HttpTransport.h"

namespace ktr::linux_ {

/// Hands commands on, and has the host that redirects led to forgotten when it can no longer serve.
///
/// A command for the remembered host goes on to the account's own when no byte of it could be sent there. When it was
/// sent, and the answer is none that the service gives (silence, a refusal, a server's error, a portal's page), the
/// command has failed and the next one goes to the account's own host. Once that one has answered, the other is
/// forgotten; when it cannot be reached either, nothing is: whoever is offline keeps what is remembered. That a host is
/// passed over is kept too
/// ("DoubtedHost"), for the next program.
class RememberedHostTransport : public platform::HttpTransport {
  public:
    /// `accountHost` is asked on the main thread at each command. `domain` and `key`: where the plugin remembers the
    /// host.
    RememberedHostTransport(std::shared_ptr<platform::HttpTransport> next,
                            std::shared_ptr<platform::Preferences> preferences,
                            std::function<std::optional<std::string>()> accountHost,
                            std::string domain = platform::kSnippetsBundle, std::string key = "RedirectedHostKey");
    ~RememberedHostTransport() override;

    void send(const platform::HttpRequest& request, Completion completion) override;

  private:
    class Memory;

    std::shared_ptr<platform::HttpTransport> next_;
    std::function<std::optional<std::string>()> accountHost_;
    std::shared_ptr<Memory> memory_;
};

}  // namespace ktr::linux_
