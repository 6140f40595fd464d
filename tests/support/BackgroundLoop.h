#pragma once

#include <deque>
#include <thread>
#include <utility>
#include <vector>

#include "platform/base/VirtualTime.h"

namespace ktr::test {

/// Virtual time whose background work waits until it is run: in any order, or on threads of its own.
class BackgroundLoop : public platform::VirtualTime {
  public:
    using VirtualTime::VirtualTime;

    void runInBackground(Work work) override { waiting.push_back(std::move(work)); }

    /// Runs the work that was handed over as the given one, here. What it posts runs with `runPosted`.
    void run(std::size_t index) {
        std::exchange(waiting.at(index), [] {})();
    }
    /// Runs all that waits, each on a thread of its own, all at once.
    void runOnThreads() {
        std::vector<std::thread> threads;
        for (Work& work : std::exchange(waiting, {})) {
            threads.emplace_back(std::move(work));
        }
        for (std::thread& thread : threads) {
            thread.join();
        }
    }

    std::deque<Work> waiting;
};

}  // namespace ktr::test
