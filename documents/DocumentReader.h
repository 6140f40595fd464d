#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "documents/DocumentError.h"
#include "documents/FieldReader.h"

namespace ktr::documents {

/// Reads the JSON documents of the development service: strict JSON with an object at the root. Any thread.
class DocumentReader {
  public:
    using Read = std::function<void(FieldReader&)>;

    /// None when all went well, else the first complaint of the text or of `read`.
    static std::optional<DocumentError> readText(std::string_view text, const std::string& file, const Read& read);
    /// The file's text, or why it cannot be read.
    static std::variant<std::string, DocumentError> textOf(const std::string& file);
};

}  // namespace ktr::documents
