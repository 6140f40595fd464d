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
    /// `domains`: who is allowed besides that host, each a domain (it and all its subdomains, at the service's port), a
    /// machine of the local network (a name of one label) or an address, with ":port" when the port is another. Without
    /// a list it is the service's registrable domain (public suffix list); for an address, or a name without such a
    /// domain
    /// ("localhost"), nobody. An empty list is the host alone.
    ServicePolicy(const std::string& serviceHost, const std::optional<std::vector<std::string>>& domains);

    bool allows(const Origin& origin) const;

    /// What stands in `domains` and allows nobody: what is no host, and a public suffix such as "org" or "co.uk", below
    /// which anybody can have a name.
    const std::vector<std::string>& entriesForNobody() const { return entriesForNobody_; }

    bool operator==(const ServicePolicy&) const = default;

  private:
    struct Rule {
        Origin origin;
        bool withSubdomains = false;
        bool operator==(const Rule&) const = default;
    };
    void allow(const std::string& entry, int servicePort);

    std::vector<Rule> rules_;
    std::vector<std::string> entriesForNobody_;
};

}  // namespace ktr::linux_
