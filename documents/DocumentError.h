#pragma once

#include <optional>
#include <string>

#include "documents/JsonReader.h"

namespace ktr::documents {

/// Why a scenario could not be read.
struct DocumentError {
    std::string file;
    /// None when the file itself could not be read.
    std::optional<JsonPosition> position;
    /// The path inside the document; empty with no position.
    std::string path;
    std::string message;

    /// One line: `dinner.json:14:22: $.snippet.locations[2].latitude: expected a number, found a string`.
    std::string text() const;
};

}  // namespace ktr::documents
