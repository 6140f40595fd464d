#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace ktr::linux_ {

/// An event of a stream. A value.
struct StreamEvent {
    std::string id;  ///< the last one that came; empty: there was none yet
    std::string type = "message";
    std::string data;

    bool operator==(const StreamEvent&) const = default;
};

/// Reads an event stream (https://html.spec.whatwg.org/multipage/server-sent-events.html) from its bytes, wherever they
/// are cut. Any thread, one at a time.
class EventStreamParser {
  public:
    /// Of an event with all its lines, in bytes: one that is longer breaks the stream.
    static constexpr std::size_t kLargest = std::size_t{64} * 1024;

    /// The events that these bytes complete.
    std::vector<StreamEvent> feed(std::string_view bytes);
    /// It can be read no further.
    bool isBroken() const { return isBroken_; }

  private:
    void takeLine(std::string_view line, std::vector<StreamEvent>& events);

    std::string line_;
    std::string id_;
    std::string type_;
    std::string data_;
    bool hasData_ = false;
    bool afterReturn_ = false;  ///< a line feed that comes next belongs to the line that has ended
    bool isBroken_ = false;
};

}  // namespace ktr::linux_
