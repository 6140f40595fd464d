#pragma once

#include <filesystem>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "documents/DocumentError.h"
#include "documents/FieldReader.h"
#include "documents/FileReader.h"

namespace ktr::documents {

/// Reads every JSON document that people write or that this program keeps: scenarios, friends, faults, configuration,
/// preferences, tracks. One policy for all: a regular file of at most the agreed size, UTF-8 with or without a
/// byte-order mark, strict JSON with an object at the root and each member once, each value of its type and range;
/// anything else is an error with its line, column and path. A member that no reader knows is a warning. Any thread.
class DocumentReader {
  public:
    using Read = std::function<void(FieldReader&)>;

    /// None when all went well, else the first complaint of the file, the text or of `read`.
    static std::optional<DocumentError> readFile(const std::filesystem::path& file, const FileReader::Terms& terms,
                                                 const Read& read, DocumentWarnings* warnings);
    /// `file` names the text in messages.
    static std::optional<DocumentError> readText(std::string_view text, const std::string& file, const Read& read,
                                                 DocumentWarnings* warnings = nullptr);
    /// The file's text, or why it cannot be read.
    static std::variant<std::string, DocumentError> textOf(const std::filesystem::path& file,
                                                           const FileReader::Terms& terms);
    /// The text without the byte-order mark with which some editors begin UTF-8.
    static std::string_view withoutMark(std::string_view text);
};

}  // namespace ktr::documents
