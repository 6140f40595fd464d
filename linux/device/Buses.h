#pragma once

#include <string>
#include <vector>

namespace ktr::linux_ {

/// The one policy for waiting on a message bus. A bus that accepts a connection and then says nothing holds up whoever
/// asks it for as long as its library pleases: 25 seconds a call, on the thread that asks, and again when the program
/// ends. So both buses are greeted once, before anything uses them, and one that does not greet back in time is
/// switched off for this process: its users then find no bus at all, which all of them can live with.
class Buses {
  public:
    /// How long both may take to greet back, seconds. One that is well takes a few milliseconds.
    static constexpr double kGreeting = 1.0;
    /// How long the Secret Service may take where a token file answers as well, and where there is none: long enough
    /// for somebody to type a keyring's password. Seconds.
    static constexpr double kSecretBesideAFile = 3.0;
    static constexpr double kSecretAlone = 60.0;

    enum class Greeting {
        Answered,
        Refused,  ///< nobody is there: its users find that out at once, too
        Silent,
        Unknown,  ///< not an address of a local socket: nobody was asked
    };

    /// Connects to an address as the environment has it (D-Bus specification, "Server Addresses"), authenticates, says
    /// Hello and waits for an answer. Any thread; it waits for at most `seconds`.
    static Greeting greet(const std::string& address, double seconds = kGreeting);

    /// Greets the session's and the system's bus, and puts an address that refuses in the environment's place of each
    /// that is silent. One line a silent bus. Before other threads read the environment.
    static std::vector<std::string> switchOffSilent();
};

}  // namespace ktr::linux_
