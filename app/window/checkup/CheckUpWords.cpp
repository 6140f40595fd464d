#include "app/window/checkup/CheckUpWords.h"

#include <algorithm>
#include <array>
#include <string_view>
#include <utility>

namespace ktr::app {

CheckUpWords::Trouble CheckUpWords::of(linux_::CheckUp::Cause cause) {
    using Cause = linux_::CheckUp::Cause;
    switch (cause) {
        case Cause::Nobody:
            return {"CHECK_NOBODY", "STATUS_SIGN_IN_FIRST", Mend::SignIn};
        case Cause::Locked:
            return {"CHECK_LOCKED", "CHECK_LOCKED_LINE", Mend::Unlock};
        case Cause::Unreachable:
            return {"CHECK_UNREACHABLE", "CHECK_UNREACHABLE_LINE", Mend::TryAgain};
        case Cause::NotTrusted:
            return {"STATUS_UNTRUSTED", "SIGN_IN_NOT_TRUSTED", Mend::TryAgain};
        case Cause::NoService:
            return {"STATUS_FAULTY", "SIGN_IN_NO_SERVICE", Mend::TryAgain};
        case Cause::Failing:
            return {"STATUS_FAULTY", "SIGN_IN_FAILING", Mend::TryAgain};
        case Cause::Unknown:
            return {"CHECK_UNKNOWN", "STATUS_SIGN_IN", Mend::SignInAgain};
        case Cause::Redirect:
            return {"CHECK_UNREACHABLE", "CHECK_REDIRECT_LINE", Mend::CopyCommand};
        case Cause::ClockAhead:
            return {"CHECK_CLOCKS", "CHECK_AHEAD", Mend::SetClock};
        case Cause::ClockBehind:
            return {"CHECK_CLOCKS", "CHECK_BEHIND", Mend::SetClock};
        case Cause::Contacts:
            return {"CHECK_NO_CONTACTS", "CHECK_FILE_LINE", Mend::Settings};
        case Cause::AddressBooks:
            return {"CHECK_BOOKS_SILENT", "CHECK_BOOKS_LINE", Mend::AskAgain};
        case Cause::Position:
            return {"CHECK_NOWHERE", "CHECK_NOWHERE_LINE", Mend::CopyCommand};
        case Cause::Map:
            return {"CHECK_NO_MAP", "CHECK_FILE_LINE", Mend::Settings};
        case Cause::Letters:
            return {"CHECK_NO_LETTERS", "CHECK_LETTERS_LINE", Mend::CopyCommand};
        case Cause::ScreenReader:
            return {"CHECK_DEAF", "CHECK_DEAF_LINE", Mend::CopyCommand};
        case Cause::Desktop:
            return {"CHECK_NO_DESKTOP", "CHECK_NO_DESKTOP_LINE", Mend::CopyCommand};
        case Cause::Settings:
        case Cause::None:
            break;
    }
    return {"STATUS_UNREADABLE", "CHECK_FILE_LINE", Mend::TryAgain};
}

const char* CheckUpWords::nameOf(const std::string& thing) {
    constexpr std::array<std::pair<std::string_view, const char*>, 12> kNames = {{
        {"settings", "SETTINGS"},
        {"account", "CHECK_ACCOUNT"},
        {"secret", "SIGN_IN_SECRET"},
        {"service", "CHECK_SERVICE"},
        {"clock", "CHECK_CLOCK"},
        {"contacts", "CHECK_CONTACTS"},
        {"address books", "SETTINGS_BOOKS"},
        {"position", "SETTINGS_POSITION"},
        {"maps", "SETTINGS_MAPS"},
        {"letters", "CHECK_LETTERS"},
        {"screen reader", "CHECK_READER"},
        {"portals", "CHECK_DESKTOP"},
    }};
    const auto found = std::find_if(kNames.begin(), kNames.end(), [&](const auto& one) { return one.first == thing; });
    return found == kNames.end() ? nullptr : found->second;
}

const char* CheckUpWords::wordsOf(Mend mend) {
    switch (mend) {
        case Mend::TryAgain:
            break;
        case Mend::SignIn:
            return "SIGN_IN_GO";
        case Mend::SignInAgain:
            return "CHECK_SIGN_IN_AGAIN";
        case Mend::Unlock:
            return "SIGN_IN_UNLOCK";
        case Mend::SetClock:
            return "CHECK_SET_CLOCK";
        case Mend::Settings:
            return "SETTINGS";
        case Mend::AskAgain:
            return "CHECK_ASK_AGAIN";
        case Mend::CopyCommand:
            return "CHECK_COMMAND";
    }
    return "SIGN_IN_RETRY";
}

}  // namespace ktr::app
