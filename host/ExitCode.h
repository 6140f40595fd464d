#pragma once

namespace ktr::host {

/// What an attempt came to; a program may take it for its exit status.
enum class ExitCode {
    Ok = 0,
    Failure = 1,      ///< something could not be done: a file not written, no display, contacts not read
    Usage = 2,        ///< the command line is wrong
    BadScenario = 3,  ///< a scenario cannot be read
    NotDrawn = 4,     ///< an answer that cannot be drawn: its kind, the text size or the size of the picture
    Plugin = 5,       ///< the plugin cannot be loaded
};

}  // namespace ktr::host
