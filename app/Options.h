#pragma once

#include <string>
#include <vector>

#include "app/KeepingOptions.h"
#include "app/WatchCommand.h"
#include "app/WyomingCommand.h"
#include "host/HostOptions.h"
#include "serve/ServeOptions.h"

namespace ktr::app {

/// What the command line asks for. Members that are none leave the decision to the scenario, then to the session.
struct Options : host::HostOptions {
    enum class Command { Show, Open, Render, Describe, Ask, Serve, AddMap, Watch, Wyoming, Search, Config, Doctor };

    Command command = Command::Show;
    std::vector<std::string> scenarios;  ///< never empty where nothing is live, but for serve
    /// With the account, the service and the present moment: a window without scenarios, and what --live asks for.
    bool live = false;
    double liveSeconds = 0.0;            ///< of a live render and describe: how long it goes on
    std::vector<std::string> questions;  ///< of what is live: asked at the start, in this order
    std::string output;                  ///< of render: a file ending in .png, .svg or .pdf
    bool json = false;                   ///< of ask: all of the answer, as JSON
    bool speak = false;                  ///< of ask: say it aloud
    bool aloud = false;                  ///< of ask: whoever is in the room gets the answer
    int searchIdle = 60;                 ///< of search: seconds without a call until it ends
    std::string plugin;                  ///< empty: looked for
    serve::ServeOptions serve;           ///< of serve
    WatchCommand::Options watch;         ///< of watch
    ConfigOptions config;                ///< of config
    DoctorOptions doctor;                ///< of doctor
    WyomingCommand::Options wyoming;     ///< of wyoming
    bool reducedMotion = false;          ///< of show
    std::string map;                     ///< of maps add: the file
    std::string link;                    ///< of a window: opened once it is there; empty for none
    bool printUrls = false;              ///< of show: URLs go to the standard output instead of the desktop
};

}  // namespace ktr::app
