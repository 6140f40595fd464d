#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <variant>

#include "platform/base/Value.h"

namespace ktr::app {

/// Reads the frames of a voice assistant's protocol out of bytes as they come: a line of JSON with the frame's `type`,
/// then as many bytes of JSON as its `data_length` says, then as many bytes of anything as its `payload_length` says.
/// Keeps at most one frame's bytes. Any thread.
class WyomingFrames {
  public:
    /// The longest line and the longest data, bytes. A payload is sound, and passed over.
    static constexpr std::size_t kLongestPart = 16384;
    static constexpr std::size_t kLongestPayload = 65536;

    struct Frame {
        std::string type;
        /// The line's own `data`, and over it what came behind the line.
        platform::Dictionary data;
    };
    /// There is no whole frame yet.
    struct Waiting {};
    /// What came is no frame, or one beyond the limits: nothing behind it can be read.
    struct Broken {};
    using Next = std::variant<Waiting, Frame, Broken>;

    void add(std::string_view bytes) { bytes_.append(bytes); }
    /// Takes the next frame. After `Broken` it is always that.
    Next next();

    /// A frame in one line.
    static std::string line(const std::string& type, const platform::Dictionary& data);

  private:
    /// False: that is no frame's line.
    bool readHeader(std::string_view text);
    Next finish();

    std::string bytes_;
    bool isBroken_ = false;
    bool hasHeader_ = false;  ///< the frame's line was taken out of the bytes
    Frame frame_;
    std::size_t dataLength_ = 0;
    std::size_t payloadLength_ = 0;
};

}  // namespace ktr::app
