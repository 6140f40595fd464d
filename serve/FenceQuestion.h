#pragma once

#include <optional>

#include "serve/QuestionWords.h"

namespace ktr::serve {

/// Understands whether a question asks to be told of somebody's coming or going: "Tell me when Ann leaves work", "Let
/// me know once Otto gets home", "Notify me where Ann is right now". Who it is about is the caller's to find. Any
/// thread.
struct FenceQuestion {
    enum class Trigger { Immediate, Departure, Arrival };

    Trigger trigger = Trigger::Arrival;
    /// The place's words, joined by blanks; empty when none is named.
    QString place;
    /// "When Ann is ...": means a fence only if there is such a place.
    bool needsPlace = false;

    /// None: it is about something else.
    static std::optional<FenceQuestion> read(const QuestionWords& question);
};

}  // namespace ktr::serve
