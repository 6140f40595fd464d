#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "host/live/ServiceWatch.h"
#include "platform/base/Date.h"

namespace ktr::host {

/// What the status line says of a live conversation. A value.
struct LiveStatus {
    /// What stands before the words; the words carry the meaning alone.
    enum class Mark { None, Live, Waiting, Warning, Hidden };
    /// What stands at the end of the line, for who wants to mend it.
    enum class Help {
        None,
        TryNow,   ///< asks at once whether the service is there again
        CheckUp,  ///< looks at everything that it stands on
    };

    /// What there is to know.
    struct Facts {
        bool ready = false;       ///< the account has been read
        bool signedIn = false;    ///< there is an account with a token
        bool hasAccount = false;  ///< somebody was signed in here, with a token or without
        bool unusable = false;    ///< the configuration is broken
        /// Since when a question waits for its answer.
        std::optional<platform::Date> asking;
        /// How the last question ended, and when.
        ServiceWatch::Trouble assistant = ServiceWatch::Trouble::None;
        platform::Date assistantEnded;
        /// When what is on screen was first known; none: nothing is on screen.
        std::optional<platform::Date> shown;
        /// What is on screen was an answer of the assistant's. Other than a scenario it says that somebody was asked.
        bool wasAsked = false;
        /// The user's position is still looked for.
        bool findingPosition = false;
        /// What is on screen last says that friends cannot see the user.
        bool hidden = false;
        ServiceWatch::Notes service;
        platform::Date now;
    };

    /// A text of the host by its key, the clock face of a moment, and a whole number in the language's own digits.
    struct Words {
        std::function<std::string(const std::string& key)> text;
        std::function<std::string(platform::Date moment)> clock;
        std::function<std::string(std::int64_t number)> number;
    };

    /// A question that is answered within this time is not called waiting, seconds.
    static constexpr double kPatience = 0.5;
    /// Younger than this is "just now", seconds.
    static constexpr double kJustNow = 15.0;

    static LiveStatus of(const Facts& facts, const Words& words);
    /// After how many seconds it may say something else although nothing happens. None: never.
    static std::optional<double> changesIn(const Facts& facts);

    Mark mark = Mark::None;
    std::string words;         ///< empty: the line is empty
    bool wantsSignIn = false;  ///< nothing is told until somebody signs in
    Help help = Help::None;
    bool operator==(const LiveStatus&) const = default;
};

}  // namespace ktr::host
