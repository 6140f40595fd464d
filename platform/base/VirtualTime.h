#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <map>
#include <mutex>
#include <optional>
#include <thread>

#include "platform/base/Clock.h"
#include "platform/base/MainLoop.h"

namespace ktr::platform {

/// A main loop and clock whose time moves only when asked to: rendering and tests use it instead of waiting. Background
/// work runs on the main thread, as a turn of its own. Everything but `post` and `runInBackground` belongs to the
/// thread that made it.
class KTR_API VirtualTime : public MainLoop, public Clock {
  public:
    explicit VirtualTime(Date start);
    ~VirtualTime() override;

    void post(Work work) override;
    std::shared_ptr<Timer> schedule(double seconds, bool repeats, Work work) override;
    void runInBackground(Work work) override;
    bool isMainThread() const override;
    Date now() const override;

    /// Runs what is posted, and what that posts, without moving the clock; at most `turns` turns.
    void runPosted(std::size_t turns = 1'000'000);
    /// Moves the clock by `seconds`, firing every timer at its own time.
    void advance(double seconds);
    /// Runs until nothing is posted and no one-shot timer is due within `horizon` seconds. Repeating timers fire on the
    /// way but do not keep it running. Returns the seconds passed.
    double runUntilIdle(double horizon);
    /// Timers that can still fire.
    std::size_t pendingTimers() const;

  private:
    class VirtualTimer;
    struct Entry {
        std::shared_ptr<VirtualTimer> timer;
        Work work;
        bool repeats = false;
    };
    /// Ordered by due time, then by the order of scheduling.
    using Key = std::pair<double, std::uint64_t>;

    void fireFirst();
    void dropInvalid();
    std::optional<double> nextDue(bool oneShotOnly) const;

    std::thread::id thread_;
    double now_;
    std::uint64_t sequence_ = 0;
    std::map<Key, Entry> timers_;
    mutable std::mutex mutex_;
    std::deque<Work> posted_;
};

}  // namespace ktr::platform
