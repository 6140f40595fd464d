#pragma once

#include "app/Options.h"
#include "ask/Answer.h"
#include "host/ExitCode.h"
#include "host/Host.h"

namespace ktr::app {

/// Asks one question and says the answer: its sentence, or all of it as JSON, on the standard output; aloud; as a
/// picture. Main thread, with Qt's event loop.
class AskCommand {
  public:
    AskCommand(host::Host& host, const Options& options) : host_(host), options_(options) {}
    /// What the program ends with: 0 for what was found, 10 to 18 by outcome, else what went wrong.
    int run();

  private:
    /// Lets what the answer still waits for happen: faces, and the map.
    void settle();
    int write(const std::string& question, const ask::Answer& answer);

    host::Host& host_;
    const Options& options_;
};

}  // namespace ktr::app
