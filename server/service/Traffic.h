#pragma once

#include <array>
#include <atomic>
#include <chrono>
#include <cstdint>
#include <memory>
#include <string>

#include "server/http/HttpReply.h"
#include "server/http/HttpRequest.h"
#include "server/service/ServiceLog.h"

namespace ktr::server {

/// How many requests came, by what for, how they were answered and how long that took: numbers without people, of the
/// paths only which of a few they are. Any thread.
class Traffic {
  public:
    /// What a request is for.
    enum class Route { Phone, Tracker, GetLocations, ShowHideLocation, Health, Metrics, Page, Fences, Events, Other };
    static constexpr std::size_t kRoutes = 10;
    static Route routeOf(const HttpRequest& request);

    /// Failures are written to the log, when there is one.
    explicit Traffic(std::shared_ptr<ServiceLog> log) : log_(std::move(log)) {}

    /// A reply that notes what becomes of it.
    HttpReply watched(const HttpRequest& request, HttpReply reply);
    /// In the text format of Prometheus.
    std::string text() const;

  private:
    using Clock = std::chrono::steady_clock;
    /// Upper bounds, in milliseconds; what takes longer is in the whole number alone.
    static constexpr std::array<std::int64_t, 8> kBounds{1, 5, 10, 50, 100, 500, 1000, 5000};
    struct Numbers {
        std::array<std::atomic<std::int64_t>, 6> byClass{};  ///< of status: 1xx to 5xx; first those without an answer
        std::array<std::atomic<std::int64_t>, kBounds.size()> within{};
        std::atomic<std::int64_t> microseconds = 0;
    };

    void note(Route route, int status, Clock::duration time);

    const std::shared_ptr<ServiceLog> log_;
    std::array<Numbers, kRoutes> numbers_;
};

}  // namespace ktr::server
