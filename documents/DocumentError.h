#pragma once

#include <optional>
#include <string>
#include <vector>

#include "documents/JsonReader.h"

namespace ktr::documents {

/// Why a document could not be read, or what was passed over in it.
struct DocumentError {
    std::string file;
    /// None when the file itself could not be read.
    std::optional<JsonPosition> position;
    /// The path inside the document; empty with no position, and where there are no paths.
    std::string path;
    std::string message;
    /// There is no such file.
    bool isMissing = false;

    /// One line: `dinner.json:14:22: $.snippet.locations[2].latitude: expected a number, found a string`.
    std::string text() const;
};

/// What was passed over, in the document's order.
using DocumentWarnings = std::vector<DocumentError>;

}  // namespace ktr::documents
