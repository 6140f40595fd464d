#pragma once

namespace ktr::linux_ {

/// Whether a program may open as many files as it is going to need: threads, event loops, connections and pipes take
/// descriptors, and the libraries behind them end the process with a signal when there are none.
class Descriptors {
  public:
    /// What a live conversation in a window takes at most, with room to spare; what any other command takes.
    static constexpr int kForLive = 48;
    static constexpr int kForOthers = 28;

    /// Whether so many more can be opened: raises this process's limit as far as it may, and tries. Any thread.
    static bool areEnough(int wanted);
};

}  // namespace ktr::linux_
