#include "documents/DocumentReader.h"

#include <filesystem>
#include <fstream>
#include <iterator>

#include "documents/JsonReader.h"

namespace ktr::documents {

std::optional<DocumentError> DocumentReader::readText(std::string_view text, const std::string& file,
                                                      const Read& read) {
    const auto document = JsonReader::read(text);
    if (const auto* error = std::get_if<JsonError>(&document)) {
        return DocumentError{file, error->position, error->path.text(), error->message};
    }
    const auto& root = std::get<platform::Value>(document);
    if (root.dictionary() == nullptr) {
        return DocumentError{file, JsonReader::locate(text, {}), "$", "expected an object, found " + nameOfKind(root)};
    }
    Complaints complaints;
    FieldReader fields(*root.dictionary(), {}, complaints);
    read(fields);
    if (complaints) {
        return DocumentError{file, JsonReader::locate(text, complaints->path), complaints->path.text(),
                             complaints->message};
    }
    return std::nullopt;
}

std::variant<std::string, DocumentError> DocumentReader::textOf(const std::string& file) {
    std::error_code failure;
    const auto type = std::filesystem::status(file, failure).type();
    if (type == std::filesystem::file_type::not_found) {
        return DocumentError{file, std::nullopt, "", "there is no such file"};
    }
    std::ifstream stream(file, std::ios::binary);
    if (!stream || type != std::filesystem::file_type::regular) {
        return DocumentError{file, std::nullopt, "", "the file cannot be read"};
    }
    return std::string(std::istreambuf_iterator<char>(stream), {});
}

}  // namespace ktr::documents
