#pragma once

#include <string>
#include <vector>

#include "serve/CertificateKind.h"
#include "serve/Fault.h"

namespace ktr::serve {

/// What the command line of `ktr serve` asks for.
struct ServeOptions {
    int port = 0;             ///< 0: a free one
    std::string folder;       ///< of certificates and token; empty: "serve" in the state folder
    std::string friends;      ///< a friends file or a scenario; empty: the demo people
    std::string faultScript;  ///< a file; empty: none
    std::vector<Fault> faults;
    double intervalSeconds = -1.0;  ///< negative: as the friends file says
    std::string personId = "1000";
    std::string positions;  ///< for the printed configuration: the user's own track; empty: none
    std::string contacts;   ///< for the configuration: vCards; empty: made of the friends
    bool printConfig = false;
    std::string writeConfig;  ///< a file; empty: none
    bool untilStdinCloses = false;
    CertificateKind certificate = CertificateKind::Good;
};

}  // namespace ktr::serve
