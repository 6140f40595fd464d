#pragma once

#include <cstdint>
#include <optional>

#include "server/ingest/Fix.h"
#include "server/ingest/Report.h"

namespace ktr::server {

/// What of a reported position is kept. Any thread.
class FixRules {
  public:
    /// A clock ahead by more than this is wrong: the time heard is nearer to the truth. Seconds.
    static constexpr std::int64_t kMostAhead = 300;
    /// How long a fix is kept, unless a person says otherwise. Seconds.
    static constexpr std::int64_t kRetention = std::int64_t{48} * 3600;

    enum class Loss { None, NoPlace, NoTime, TooOld };
    struct Outcome {
        std::optional<Fix> fix;
        Loss loss = Loss::None;
    };

    /// None for no place on earth, for 0/0 without an accuracy (what a phone says that knows none), without a time, and
    /// beyond the retention. An accuracy that is no positive length is unknown.
    static Outcome admit(const RawFix& raw, std::int64_t now, std::int64_t retention = kRetention);
};

}  // namespace ktr::server
