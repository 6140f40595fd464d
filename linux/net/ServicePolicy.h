#pragma once

#include <optional>
#include <string>
#include <vector>

#include "linux/net/Origin.h"

namespace ktr::linux_ {

/// Who may hear the commands of an account, its token among them: the account's service and the hosts that belong to
/// it. A value; any thread.
class ServicePolicy {
  public:
    /// `serviceHost`: the host that the account names, with its port, if any; one that is none allows nobody.
    /// `domains`: what is allowed besides the service's own domain, each a domain (it and all its subdomains, at the
    /// service's port) or an address, with ":port" when the port is another. A domain that nobody can register, such as
    /// "org", allows nobody.
    ServicePolicy(const std::string& serviceHost, const std::vector<std::string>& domains);

    /// The service's registrable domain (public suffix list) and its subdomains at the service's port; for an address,
    /// or a name without such a domain ("localhost"), exactly that origin; and what `domains` adds.
    bool allows(const Origin& origin) const;

    bool operator==(const ServicePolicy&) const = default;

  private:
    struct Rule {
        Origin origin;
        bool withSubdomains = false;
        bool operator==(const Rule&) const = default;
    };
    std::vector<Rule> rules_;
};

}  // namespace ktr::linux_
