#include "server/service/Traffic.h"

#include <algorithm>
#include <string_view>
#include <utility>

namespace ktr::server {

namespace {

using Word = ServiceLog::Word;

constexpr std::array<Word, Traffic::kRoutes> kNames{
    Word("phone"),   Word("tracker"), Word("getlocations"), Word("showhide"), Word("health"),
    Word("metrics"), Word("page"),    Word("fences"),       Word("events"),   Word("other")};

constexpr std::pair<std::string_view, Traffic::Route> kPaths[] = {
    {"/pub", Traffic::Route::Phone},
    {"/", Traffic::Route::Tracker},
    {"/qloxservice/friends/va/getlocations", Traffic::Route::GetLocations},
    {"/qloxservice/friends/va/showHideLocation", Traffic::Route::ShowHideLocation},
    {"/qloxservice/friends/va/setFence", Traffic::Route::Fences},
    {"/qloxservice/friends/va/fences", Traffic::Route::Fences},
    {"/qloxservice/friends/va/endFence", Traffic::Route::Fences},
    {"/qloxservice/friends/va/events", Traffic::Route::Events},
    {"/health", Traffic::Route::Health},
    {"/metrics", Traffic::Route::Metrics},
};

std::string labelled(const char* name, std::size_t route, const std::string& more, const std::string& value) {
    return std::string(name) + "{route=\"" + std::string(kNames[route].text()) + "\"" + more + "} " + value + "\n";
}

/// Seconds, in decimal notation, of whole microseconds.
std::string secondsOf(std::int64_t microseconds) {
    std::string fraction = std::to_string(microseconds % 1000000);
    fraction.insert(0, 6 - fraction.size(), '0');
    return std::to_string(microseconds / 1000000) + "." + fraction;
}

}  // namespace

Traffic::Route Traffic::routeOf(const HttpRequest& request) {
    for (const auto& [path, route] : kPaths) {
        if (request.path == path) {
            return route;
        }
    }
    return request.path == "/me" || request.path.rfind("/me/", 0) == 0 ? Route::Page : Route::Other;
}

HttpReply Traffic::watched(const HttpRequest& request, HttpReply reply) {
    const Route route = routeOf(request);
    return HttpReply([this, route, began = Clock::now(), last = std::make_shared<HttpReply>(std::move(reply))](
                         std::optional<HttpResponse> response) mutable {
        note(route, response ? response->status : 0, Clock::now() - began);
        if (response) {
            last->send(std::move(*response));
        }
        // Without an answer the last reply goes with this, and the connection ends.
        last.reset();
    });
}

void Traffic::note(Route route, int status, Clock::duration time) {
    const auto microseconds = std::chrono::duration_cast<std::chrono::microseconds>(time).count();
    Numbers& numbers = numbers_[static_cast<std::size_t>(route)];
    ++numbers.byClass[static_cast<std::size_t>(std::clamp(status / 100, 0, 5))];
    numbers.microseconds += microseconds;
    for (std::size_t i = 0; i < kBounds.size(); ++i) {
        numbers.within[i] += microseconds <= kBounds[i] * 1000 ? 1 : 0;
    }
    if (log_ && (status == 0 || status >= 400)) {
        log_->write(status == 0 || status >= 500 ? ServiceLog::Level::Warning : ServiceLog::Level::Info,
                    status == 0 || status >= 500 ? Word("failed") : Word("refused"),
                    {{"route", kNames[static_cast<std::size_t>(route)]},
                     {"status", std::int64_t{status}},
                     {"ms", std::int64_t{microseconds / 1000}}});
    }
}

std::string Traffic::text() const {
    constexpr const char* kRequests = "ktr_service_requests_total";
    constexpr const char* kSeconds = "ktr_service_request_seconds";
    std::string counts = std::string("# TYPE ") + kRequests + " counter\n";
    std::string times = std::string("# TYPE ") + kSeconds + " histogram\n";
    for (std::size_t route = 0; route < kRoutes; ++route) {
        const Numbers& numbers = numbers_[route];
        std::int64_t all = 0;
        for (std::size_t i = 0; i < numbers.byClass.size(); ++i) {
            const std::int64_t count = numbers.byClass[i].load();
            all += count;
            if (count > 0) {
                counts +=
                    labelled(kRequests, route, i == 0 ? ",status=\"none\"" : ",status=\"" + std::to_string(i) + "xx\"",
                             std::to_string(count));
            }
        }
        if (all == 0) {
            continue;
        }
        const std::string bucket = std::string(kSeconds) + "_bucket";
        for (std::size_t i = 0; i < kBounds.size(); ++i) {
            // Notes that come in between: a bucket never holds more than the whole.
            times += labelled(bucket.c_str(), route, ",le=\"" + secondsOf(kBounds[i] * 1000) + "\"",
                              std::to_string(std::min(all, numbers.within[i].load())));
        }
        times += labelled(bucket.c_str(), route, ",le=\"+Inf\"", std::to_string(all));
        times += labelled((std::string(kSeconds) + "_sum").c_str(), route, "", secondsOf(numbers.microseconds.load()));
        times += labelled((std::string(kSeconds) + "_count").c_str(), route, "", std::to_string(all));
    }
    return counts + times;
}

}  // namespace ktr::server
