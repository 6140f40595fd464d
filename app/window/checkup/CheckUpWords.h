#pragma once

#include "linux/doctor/CheckUp.h"

namespace ktr::app {

/// The words of a check-up's findings, as keys of the host's texts. Any thread.
class CheckUpWords {
  public:
    /// What the button beside a thing that is wrong does.
    enum class Mend { TryAgain, SignIn, SignInAgain, Unlock, SetClock, Settings, AskAgain, CopyCommand };

    struct Trouble {
        const char* title;
        const char* cause;  ///< takes the finding's detail where it says something of it
        Mend mend;
    };

    /// Of what is wrong.
    static Trouble of(linux_::CheckUp::Cause cause);
    /// Of what is fine; null for what is part of something else.
    static const char* nameOf(const std::string& thing);
    static const char* wordsOf(Mend mend);
};

}  // namespace ktr::app
