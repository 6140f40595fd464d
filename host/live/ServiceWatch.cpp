#include "host/live/ServiceWatch.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <string_view>
#include <utility>

namespace ktr::host {

using platform::HttpAnswer;
using platform::HttpFailure;

namespace {

constexpr double kMillisecondsASecond = 1000.0;

/// The number that a text begins with; 0 for none.
double leadingNumber(std::string_view text) {
    text.remove_prefix(std::min(text.find_first_not_of(" \t\n\v\f\r"), text.size()));
    text.remove_prefix(text.starts_with('+') ? 1 : 0);
    double number = 0.0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

}  // namespace

ServiceWatch::ServiceWatch(std::shared_ptr<platform::HttpTransport> next, std::shared_ptr<platform::MainLoop> mainLoop,
                           std::shared_ptr<platform::Clock> clock)
    : mainLoop_(std::move(mainLoop)), state_(std::make_shared<State>()), next_(std::move(next)) {
    state_->clock = std::move(clock);
}

ServiceWatch::~ServiceWatch() {
    state_->changed = nullptr;
}

ServiceWatch::Trouble ServiceWatch::troubleOf(HttpFailure failure, int status, bool isUsable) {
    constexpr int kUnauthorized = 401;
    switch (failure) {
        case HttpFailure::None:
            return status == kUnauthorized ? Trouble::SignedOut : isUsable ? Trouble::None : Trouble::Faulty;
        case HttpFailure::Tls:
            return Trouble::Untrusted;
        case HttpFailure::BadAnswer:
        case HttpFailure::TooLarge:
        case HttpFailure::RedirectRefused:
            return Trouble::Faulty;
        case HttpFailure::BadRequest:
        case HttpFailure::Network:
        case HttpFailure::Timeout:
        case HttpFailure::Cancelled:
            break;
    }
    return Trouble::Unreachable;
}

ServiceWatch::Trouble ServiceWatch::troubleOf(const HttpAnswer& answer) {
    return troubleOf(answer.failure, answer.status, answer.json && answer.json->dictionary() != nullptr);
}

double ServiceWatch::intervalOf(const HttpAnswer& answer) {
    const auto* root = answer.json ? answer.json->dictionary() : nullptr;
    const auto* context = root != nullptr ? root->find("serverContext") : nullptr;
    const auto* fields = context != nullptr ? context->dictionary() : nullptr;
    const auto* interval = fields != nullptr ? fields->find("minCallbackIntervalInMS") : nullptr;
    if (interval == nullptr) {
        return 0.0;
    }
    const std::string* text = interval->string();
    const double milliseconds = text != nullptr ? leadingNumber(*text) : interval->number().value_or(0.0);
    return std::isfinite(milliseconds) && milliseconds > 0.0 ? milliseconds / kMillisecondsASecond : 0.0;
}

void ServiceWatch::State::take(std::optional<Trouble> trouble, std::optional<double> interval) {
    --notes.underWay;
    notes.trouble = trouble.value_or(notes.trouble);
    if (interval) {
        notes.answered = clock->now();
        notes.interval = *interval;
        ++notes.answers;
    } else if (trouble) {
        ++notes.failures;
    }
    if (changed) {
        changed();
    }
}

void ServiceWatch::send(const platform::HttpRequest& request, Completion completion) {
    ++state_->notes.underWay;
    if (state_->changed) {
        state_->changed();
    }
    // The loop outlives every command: whoever owns it ends the transport first.
    platform::MainLoop* const mainLoop = mainLoop_.get();
    next_->send(request, [state = state_, mainLoop, completion = std::move(completion)](HttpAnswer answer) {
        const auto trouble = answer.failure == HttpFailure::Cancelled ? std::nullopt : std::optional(troubleOf(answer));
        const auto interval = trouble == Trouble::None ? std::optional(intervalOf(answer)) : std::nullopt;
        completion(std::move(answer));
        mainLoop->post([state, trouble, interval] { state->take(trouble, interval); });
    });
}

}  // namespace ktr::host
