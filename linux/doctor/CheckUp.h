#pragma once

#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace ktr::linux_ {

/// Looks at everything that this program stands on, each thing by itself and for a bounded time: what is fine, and what
/// is wrong with the command that mends it. Nothing is changed, and the service is asked for nobody's place.
class CheckUp {
  public:
    enum class State {
        Fine,
        Wrong,
        NotUsed,  ///< nothing here asks for it
    };
    /// What is wrong, for who words it in another language.
    enum class Cause {
        None,
        Settings,
        Nobody,  ///< is signed in
        Locked,  ///< the secret cannot be read
        Unreachable,
        NotTrusted,
        NoService,
        Failing,
        Unknown,  ///< the service does not know person and secret together
        Redirect,
        ClockAhead,
        ClockBehind,
        Contacts,
        AddressBooks,
        Position,
        Map,
        Letters,
        ScreenReader,
        Desktop,
    };
    /// What came of looking at one thing. Its words hold no friend, no place and no secret; a file is named by its
    /// path.
    struct Finding {
        std::string thing;  ///< "account", "secret", "name", ...: the same in every language
        State state = State::Fine;
        std::string words;   ///< one line, English
        std::string remedy;  ///< of what is wrong: a command, or whom to ask; else empty
        double seconds = 0.0;
        Cause cause = Cause::None;  ///< of what is wrong
        std::string detail = {};    ///< of the cause: a host, a number of minutes; what is told beside what is fine
    };
    /// One thing to look at.
    struct Check {
        std::string thing;
        double patience = 0.0;
        std::function<Finding()> look;
        std::string silent;  ///< the words where it takes longer
        std::string remedy;
        Cause cause = Cause::None;  ///< of its silence
        std::string detail = {};
    };
    /// Where everything is found; a test has its own.
    struct Places {
        std::filesystem::path configuration;
        std::filesystem::path preferences;  ///< the file of the plugin's preferences
        std::filesystem::path maps;         ///< the folder of the maps that were added
        std::filesystem::path texts;        ///< the folder of the texts of each language
        std::string language;               ///< of the session, BCP 47
        std::string sessionBus;             ///< addresses; empty: none
        std::string systemBus;
        double patience = 5.0;  ///< seconds for each thing; the service and what asks it have longer
    };

    /// In the order in which they are told. Waits no longer than the slowest thing may take; what has not ended by then
    /// goes on in the background and is told as silent. Any thread; a QGuiApplication exists.
    static std::vector<Finding> run(const Places& places);
    /// The same by pieces, for who shows each finding as it comes: all but the letters, in the order in which they are
    /// told. It reads the disk. Any thread.
    static std::vector<Check> checks(const Places& places);
    /// Looks, for as long as it may take. Any thread.
    static Finding runOne(const Check& check) { return runAll({check}).front(); }
    /// By script. Main thread.
    static Finding letters();

    /// The findings as people read them, a line each and one for each remedy.
    static std::string text(const std::vector<Finding>& findings);
    /// The same as JSON: {"ok": ..., "findings": [{"thing", "state", "words", "remedy", "milliseconds", "cause"}]}.
    static std::string json(const std::vector<Finding>& findings);
    static bool isWell(const std::vector<Finding>& findings);

  private:
    static std::vector<Finding> runAll(const std::vector<Check>& checks);
};

}  // namespace ktr::linux_
