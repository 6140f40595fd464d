#include "linux/net/RememberedHostTransport.h"

#include <utility>

namespace ktr::linux_ {

using platform::HttpAnswer;
using platform::HttpFailure;

namespace {

constexpr int kUnauthorized = 401;

/// Whether the host that the command was sent to cannot serve this account. What another host said, to which the
/// command was led from there, does not count.
bool cannotServe(const HttpAnswer& answer) {
    if (answer.redirectedHost) {
        return false;
    }
    return answer.failure == HttpFailure::Tls || answer.failure == HttpFailure::BadRequest ||
           (answer.failure == HttpFailure::None && answer.status == kUnauthorized);
}

}  // namespace

RememberedHostTransport::RememberedHostTransport(std::shared_ptr<platform::HttpTransport> next,
                                                 std::shared_ptr<platform::Preferences> preferences, std::string domain,
                                                 std::string key)
    : next_(std::move(next)), preferences_(std::move(preferences)), domain_(std::move(domain)), key_(std::move(key)) {}

RememberedHostTransport::~RememberedHostTransport() = default;

void RememberedHostTransport::send(const platform::HttpRequest& request, Completion completion) {
    next_->send(request, [preferences = preferences_, domain = domain_, key = key_, host = request.host,
                          completion = std::move(completion)](HttpAnswer answer) {
        // Another one may have been remembered meanwhile.
        if (cannotServe(answer) && preferences->value(key, domain) == host) {
            preferences->setValue(key, std::nullopt, domain);
            preferences->synchronize(domain);
        }
        completion(std::move(answer));
    });
}

}  // namespace ktr::linux_
