#pragma once

#include <memory>
#include <string>
#include <vector>

#include "app/voice/WyomingServer.h"
#include "host/ExitCode.h"
#include "host/Host.h"
#include "host/asking/QuestionDesk.h"

namespace ktr::app {

/// Answers voice assistants until it is ended: only reads, and tells only of friends who may be said aloud. Main
/// thread, with Qt's event loop.
class WyomingCommand {
  public:
    struct Options {
        static constexpr int kPort = 10390;

        std::string address = "127.0.0.1";
        int port = kPort;
        std::vector<std::string> allowed;  ///< addresses and networks beside this machine's own
    };

    /// Empty, or what is wrong with the options.
    static std::string objection(const Options& options);

    WyomingCommand(host::Host& host, const Options& options);
    /// Comes back when it cannot listen; else it ends with the process.
    host::ExitCode run();

  private:
    void ask(const std::string& text, const std::string& language, const WyomingServer::Answer& answer);
    bool listen();

    host::Host& host_;
    const Options& options_;
    host::QuestionDesk desk_;
    WyomingServer server_;
};

}  // namespace ktr::app
