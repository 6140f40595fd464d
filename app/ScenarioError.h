#pragma once

#include <optional>
#include <string>

#include "linux/json/JsonReader.h"

namespace ktr::app {

/// Why a scenario could not be read.
struct ScenarioError {
    std::string file;
    /// None when the file itself could not be read.
    std::optional<linux_::JsonPosition> position;
    /// The path inside the document; empty with no position.
    std::string path;
    std::string message;

    /// One line: `dinner.json:14:22: $.snippet.locations[2].latitude: expected a number, found a string`.
    std::string text() const;
};

}  // namespace ktr::app
