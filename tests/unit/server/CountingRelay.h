#pragma once

#include <atomic>
#include <cstddef>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace ktr::test {

/// Stands between a store and its PostgreSQL server, both on Unix sockets, and counts how often somebody waited for the
/// server: what a client sends after the server has spoken begins a way there and back. Any thread.
class CountingRelay {
  public:
    /// `target`: the folder of the server's socket. `folder`: where the relay's own is to be.
    CountingRelay(std::string target, const std::string& folder);
    ~CountingRelay();
    CountingRelay(const CountingRelay&) = delete;
    CountingRelay& operator=(const CountingRelay&) = delete;

    bool isListening() const { return listener_ >= 0; }
    std::size_t connections() const;
    /// Of the connection that was made as this one, from 0.
    int waysOf(std::size_t connection) const;

  private:
    struct Pair {
        int client = -1;
        int server = -1;
        int ways = 0;
        bool serverSpokeLast = true;
    };
    void run();
    void accept();
    /// False: one of them has ended.
    static bool pass(int from, int to);

    const std::string target_;
    int listener_ = -1;
    std::atomic<bool> ending_ = false;
    mutable std::mutex mutex_;
    std::vector<Pair> pairs_;
    std::thread thread_;
};

}  // namespace ktr::test
