#pragma once

namespace ktr::linux_ {

/// Whether a program may open as many files as it is going to need: threads, event loops, connections and pipes take
/// descriptors, and the libraries behind them end the process with a signal when there are none.
class Descriptors {
  public:
    /// What a live conversation in a window takes at most, with room to spare.
    static constexpr int kNeeded = 48;

    /// Raises this process's limit as far as it may, and tries. Any thread.
    static bool areEnough();
};

}  // namespace ktr::linux_
