#pragma once

#include <cstdint>
#include <deque>
#include <filesystem>
#include <functional>
#include <string>

#include "app/CrossingWords.h"

namespace ktr::app {

/// Crossings that are still to be posted to the user's own address: in order, one after the other, over restarts, and
/// beside everything else: nobody waits for that address. Main thread.
class HookQueue {
  public:
    static constexpr std::size_t kMost = 100;                       ///< that wait; of more the oldest goes
    static constexpr std::int64_t kLasts = std::int64_t{6} * 3600;  ///< seconds; what is older is not posted any more

    struct Setup {
        std::filesystem::path file;  ///< what waits, for its user's eyes alone
        /// Posts one, and calls `done` when somebody has taken it, or nobody will.
        std::function<void(const Crossing& crossing, std::function<void()> done)> post;
        std::function<void(const std::string& line)> tell;
        std::function<std::int64_t()> now;  ///< seconds since 1970
    };

    /// Reads what a process before left.
    explicit HookQueue(Setup setup);
    /// Posts what waits.
    void start();
    /// It is on the disk when this returns. One that was added before, by its number, is not added again.
    void add(const Crossing& crossing);
    std::size_t size() const { return waiting_.size(); }

  private:
    void write() const;
    void postNext();

    const Setup setup_;
    std::deque<Crossing> waiting_;
    std::int64_t last_ = 0;  ///< number of the one that was added last
    bool isBusy_ = false;
};

}  // namespace ktr::app
