#include "app/Messages.h"

#include <cstdio>
#include <string>

#include "documents/Words.h"

namespace ktr::app {

void tell(std::string_view line) {
    // One write a line, so that lines of other writers do not cut in.
    const std::string whole = "ktr: " + documents::forLine(line) + "\n";
    std::fwrite(whole.data(), 1, whole.size(), stderr);
    std::fflush(stderr);
}

void tell(const documents::DocumentWarnings& warnings) {
    for (const auto& warning : warnings) {
        tell("warning: " + warning.text());
    }
}

}  // namespace ktr::app
