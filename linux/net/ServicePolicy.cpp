#include "linux/net/ServicePolicy.h"

#include <algorithm>

namespace ktr::linux_ {

namespace {

bool isAtOrBelow(const std::string& host, const std::string& domain) {
    return host == domain ||
           (host.size() > domain.size() && host.ends_with(domain) && host[host.size() - domain.size() - 1] == '.');
}

/// Whether the text names a port, be it the usual one.
bool namesPort(const std::string& text) {
    return text.find(':', text.rfind(']') == std::string::npos ? 0 : text.rfind(']')) != std::string::npos;
}

}  // namespace

ServicePolicy::ServicePolicy(const std::string& serviceHost, const std::optional<std::vector<std::string>>& domains) {
    const auto service = Origin::fromText(serviceHost);
    if (!service) {
        return;
    }
    rules_.push_back({*service, false});
    if (!domains) {
        if (const auto domain = service->registrableDomain()) {
            rules_.push_back({{*domain, service->port}, true});
        }
        return;
    }
    for (const std::string& entry : *domains) {
        allow(entry, service->port);
    }
}

void ServicePolicy::allow(const std::string& entry, int servicePort) {
    auto origin = Origin::fromText(entry);
    if (!origin || origin->isPublicSuffix()) {
        entriesForNobody_.push_back(entry);
        return;
    }
    if (!namesPort(entry)) {
        origin->port = servicePort;
    }
    // A name of one label is a machine of the local network: it alone.
    rules_.push_back({*origin, origin->registrableDomain().has_value()});
}

bool ServicePolicy::allows(const Origin& origin) const {
    return std::any_of(rules_.begin(), rules_.end(), [&origin](const Rule& rule) {
        return origin.port == rule.origin.port &&
               (origin.host == rule.origin.host ||
                (rule.withSubdomains && !origin.isAddress() && isAtOrBelow(origin.host, rule.origin.host)));
    });
}

}  // namespace ktr::linux_
