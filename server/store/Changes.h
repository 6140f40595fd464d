#pragma once

#include <cstdint>
#include <functional>
#include <list>
#include <memory>
#include <mutex>
#include <set>
#include <string>
#include <string_view>

namespace ktr::server {

/// Of whom something was written that decides what somebody sees: where they are, whether they hide, what their places
/// are called, whom they let see what, what they may see themselves, or which of their secrets are good. Of a grant
/// both are named, owner and viewer. A value.
struct Change {
    bool everything = false;  ///< anybody: a restored store, or what was written while nobody could be told
    std::set<std::int64_t> people;

    bool isNothing() const { return !everything && people.empty(); }
    bool concerns(std::int64_t person) const { return everything || people.count(person) != 0; }
    void add(const Change& other);

    bool operator==(const Change&) const = default;

    /// For another process: lines of at most `limit` bytes (at least 64) that say it together. `sender` (no spaces)
    /// says who it is from.
    std::list<std::string> lines(std::string_view sender, std::size_t limit) const;
    /// What such a line says; everything, when it cannot be read. `sender` is whose it is.
    static Change ofLine(std::string_view line, std::string& sender);
};

/// Tells those who wait for a change of what somebody sees that there may be one: after each commit, whichever process
/// wrote it. It is a hint to read again: most changes change nothing for most viewers, some come twice, and none comes
/// for what changes by the clock alone (a grant that begins or ends, a coarse place that follows). Any thread.
class Changes {
  public:
    /// Called on a thread of the store, after the commit and before those who wrote hear of it, one call after the
    /// other. It must not wait, nor listen, nor end a listening.
    using Listener = std::function<void(const Change&)>;

    /// Until what it gives is destroyed: before the store is. From then on the listener is not called, nor in a call.
    [[nodiscard]] std::shared_ptr<void> listen(Listener listener);
    void tell(const Change& change);
    bool isListenedTo() const;

  private:
    mutable std::mutex mutex_;
    std::list<Listener> listeners_;
};

}  // namespace ktr::server
