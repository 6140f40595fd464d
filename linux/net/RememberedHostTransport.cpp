#include "linux/net/RememberedHostTransport.h"

#include <utility>

namespace ktr::linux_ {

using platform::HttpAnswer;
using platform::HttpFailure;

namespace {

/// What the host said cannot be the service's word. What another one said, to which the command was led from there,
/// does not count; nor does what is the command's own fault, or a wish to wait.
bool cannotServe(const HttpAnswer& answer) {
    if (answer.redirectedHost || answer.failure == HttpFailure::Cancelled) {
        return false;
    }
    if (answer.failure != HttpFailure::None) {
        return true;
    }
    switch (answer.status) {
        case 401:
        case 403:
        case 404:
        case 410:
        case 421:
            return true;
        default:
            break;
    }
    const bool isSuccess = answer.status >= 200 && answer.status < 300;
    return answer.status >= 500 || (isSuccess && !(answer.json && answer.json->dictionary() != nullptr));
}

/// Whether there was an answer, be it where to ask.
bool hasAnswered(const HttpAnswer& answer) {
    return answer.failure == HttpFailure::None || answer.failure == HttpFailure::RedirectRefused ||
           answer.redirectedHost.has_value();
}

}  // namespace

/// What is remembered, and whether it is doubted: kept beside it, since the next command may be the next program's. Any
/// thread.
class RememberedHostTransport::Memory {
  public:
    Memory(std::shared_ptr<platform::Preferences> preferences, std::string domain, std::string key)
        : preferences_(std::move(preferences)), domain_(std::move(domain)), key_(std::move(key)) {}

    bool holds(const std::string& host) const { return preferences_->value(key_, domain_) == host; }
    bool isDoubted(const std::string& host) const { return preferences_->value(kDoubtedKey, domain_) == host; }
    void doubt(const std::string& host, bool isDoubted) {
        if (isDoubted != this->isDoubted(host)) {
            preferences_->setValue(kDoubtedKey, isDoubted ? std::optional(host) : std::nullopt, domain_);
            preferences_->synchronize(domain_);
        }
    }
    /// Unless another one was remembered meanwhile.
    void forget(const std::string& host) {
        doubt(host, false);
        if (holds(host)) {
            preferences_->setValue(key_, std::nullopt, domain_);
            preferences_->synchronize(domain_);
        }
    }

  private:
    static constexpr const char* kDoubtedKey = "DoubtedHost";

    const std::shared_ptr<platform::Preferences> preferences_;
    const std::string domain_;
    const std::string key_;
};

RememberedHostTransport::RememberedHostTransport(std::shared_ptr<platform::HttpTransport> next,
                                                 std::shared_ptr<platform::Preferences> preferences,
                                                 std::function<std::optional<std::string>()> accountHost,
                                                 std::string domain, std::string key)
    : next_(std::move(next)),
      accountHost_(std::move(accountHost)),
      memory_(std::make_shared<Memory>(std::move(preferences), std::move(domain), std::move(key))) {}

RememberedHostTransport::~RememberedHostTransport() = default;

void RememberedHostTransport::send(const platform::HttpRequest& request, Completion completion) {
    const auto own = accountHost_();
    if (!own || own->empty() || request.host == *own || !memory_->holds(request.host)) {
        next_->send(request, std::move(completion));
        return;
    }
    auto asked = request;
    const bool isPassedOver = memory_->isDoubted(request.host);
    (isPassedOver ? asked.host : asked.fallbackHost) = *own;
    next_->send(asked, [memory = memory_, host = request.host, isPassedOver,
                        completion = std::move(completion)](HttpAnswer answer) {
        const bool ownWasAsked = isPassedOver || answer.fromFallback;
        if (ownWasAsked && hasAnswered(answer)) {
            memory->forget(host);
        } else {
            memory->doubt(host, !ownWasAsked && cannotServe(answer));
        }
        completion(std::move(answer));
    });
}

}  // namespace ktr::linux_
