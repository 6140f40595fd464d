#pragma once

#include <optional>

#include "serve/QuestionWords.h"

namespace ktr::serve {

/// Understands whether a question is about the user's own sharing: "Hide my location", "Let my friends see me", "Can
/// anybody see where I am?". Any thread.
class SharingQuestion {
  public:
    enum class Wish {
        Show,  ///< friends shall see where the user is
        Hide,
        Know,  ///< nothing shall change
    };
    /// None: it is about something else. What is in doubt never shows anybody.
    static std::optional<Wish> wishOf(const QuestionWords& question);
};

}  // namespace ktr::serve
