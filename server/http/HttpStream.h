#pragma once

#include <cstddef>
#include <functional>
#include <mutex>
#include <string>

namespace ktr::server {

/// The body of an answer that comes bit by bit, for as long as its client listens. One side hands bytes over, the
/// connection takes them. Never more than a bound is kept. Any thread.
class HttpStream {
  public:
    static constexpr std::size_t kMost = 65536;  ///< bytes that wait

    /// `drained` is called, on a thread of the edge, whenever all that was handed over has gone out; may be empty.
    explicit HttpStream(std::function<void()> drained) : drained_(std::move(drained)) {}

    /// False, and nothing is kept: the client is gone, the stream has ended, or too much waits already.
    bool send(const std::string& bytes);
    /// Drops what waits, and ends with these bytes.
    void end(const std::string& last = {});
    bool isDrained() const;
    bool isOver() const;

    // For the connection.

    /// From now on somebody takes: `wake` says when there is something.
    void attach(std::function<void()> wake);
    /// What is to be sent next. Empty: nothing now; or nothing any more, when `isFinished`.
    std::string take();
    bool isFinished() const;
    /// The client is gone.
    void abandon();

  private:
    const std::function<void()> drained_;
    mutable std::mutex mutex_;
    std::function<void()> wake_;
    std::string waiting_;
    bool underWay_ = false;  ///< what was taken last has not gone out
    bool ended_ = false;
    bool gone_ = false;
};

}  // namespace ktr::server
