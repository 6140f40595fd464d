#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "server/http/HttpResponse.h"
#include "server/store/Store.h"

namespace ktr::server {

/// Tells readers who came and went, as it happens: an event stream each
/// (https://html.spec.whatwg.org/multipage/server-sent-events.html), which goes on where the last one ended. What a
/// reader has not taken waits in the store, not here. Any thread.
class EventStreams {
  public:
    struct Setup {
        Store& store;
        std::function<std::int64_t()> now;
        /// Does something a little later, on a thread that may wait for the store.
        std::function<void(double seconds, std::function<void()>)> later;
        /// Between two signs of life, and the time that a reader has to take what it was sent. Seconds.
        double pause = 20.0;
    };

    explicit EventStreams(Setup setup);
    /// Ends all.
    ~EventStreams();
    EventStreams(const EventStreams&) = delete;
    EventStreams& operator=(const EventStreams&) = delete;

    /// Whatever came after the event with number `after`, and what comes. A device has one stream: an older one ends.
    HttpResponse open(const Device& device, std::int64_t after);
    std::size_t size() const;
    /// Readers that did not take what they were sent.
    std::uint64_t slowReaders() const { return slow_; }

  private:
    struct Reader;
    void concerns(const Change& change);
    void pump(const std::shared_ptr<Reader>& reader);
    /// Shows all that somebody is there, and lets go of those who are not.
    void beat();
    void schedule(double seconds, std::function<void(EventStreams&)> what);

    const Setup setup_;
    std::atomic<std::uint64_t> slow_ = 0;
    mutable std::mutex mutex_;
    std::map<std::int64_t, std::shared_ptr<Reader>> readers_;  ///< by device
    std::multimap<std::int64_t, std::int64_t> devices_;        ///< by person
    /// What runs later finds out by it that there is nobody any more.
    struct Alive {
        std::mutex mutex;
        EventStreams* streams = nullptr;
    };
    std::shared_ptr<Alive> alive_;
    std::shared_ptr<void> listening_;
};

}  // namespace ktr::server
