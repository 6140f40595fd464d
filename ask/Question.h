#pragma once

#include <optional>
#include <string>

#include "platform/base/Date.h"

namespace ktr::ask {

/// A place on earth.
struct Position {
    double latitude = 0.0;  ///< degrees
    double longitude = 0.0;
    std::optional<double> accuracy;  ///< metres; none: unknown
};

/// What somebody asks, with what the answer depends on.
struct Question {
    /// As it was typed or heard; what is longer than `kLongest` bytes is not understood.
    std::string text;
    std::string language = "en";  ///< BCP 47: of the question and of the answer's sentence
    platform::Date now;
    double secondsFromUtc = 0.0;       ///< of the asker's clock: times of day are theirs
    std::optional<Position> position;  ///< where the asker is; none: not known, and no distance is said
    /// The answer's rows go on changing while its sentence stays: the sentence says when it was true.
    bool isLive = false;
    /// Whether wishes are honoured (hide, share, tell me when). Who only reads is refused with a sentence.
    bool mayChange = true;
    /// Whoever of several the asker chose: the handle of a choice of the answer before; empty: nobody yet.
    std::string chosen = {};

    static constexpr std::size_t kLongest = 2000;
};

}  // namespace ktr::ask
