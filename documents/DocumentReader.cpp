#include "documents/DocumentReader.h"

#include "documents/JsonReader.h"

namespace ktr::documents {

std::string_view DocumentReader::withoutMark(std::string_view text) {
    constexpr std::string_view kMark = "\xEF\xBB\xBF";
    return text.starts_with(kMark) ? text.substr(kMark.size()) : text;
}

std::optional<DocumentError> DocumentReader::readText(std::string_view text, const std::string& file, const Read& read,
                                                      DocumentWarnings* warnings) {
    text = withoutMark(text);
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
    const auto placed = [&](const Complaint& complaint) {
        return DocumentError{file, JsonReader::locate(text, complaint.path), complaint.path.text(), complaint.message};
    };
    if (complaints) {
        return placed(*complaints.first);
    }
    fields.warnOfOthers();
    if (warnings != nullptr) {
        for (const Complaint& unknown : complaints.unknown) {
            warnings->push_back(placed(unknown));
        }
        if (complaints.moreUnknown > 0) {
            warnings->push_back(
                {file, std::nullopt, "",
                 "members that there are not, passed over: " + std::to_string(complaints.moreUnknown) + " more"});
        }
    }
    return std::nullopt;
}

std::variant<std::string, DocumentError> DocumentReader::textOf(const std::filesystem::path& file,
                                                                const FileReader::Terms& terms) {
    auto read = FileReader::read(file, terms);
    if (auto* error = std::get_if<FileReader::Error>(&read)) {
        return DocumentError{file.string(), std::nullopt, "", std::move(error->reason), error->isMissing};
    }
    return std::get<std::string>(std::move(read));
}

std::optional<DocumentError> DocumentReader::readFile(const std::filesystem::path& file, const FileReader::Terms& terms,
                                                      const Read& read, DocumentWarnings* warnings) {
    const auto text = textOf(file, terms);
    if (const auto* error = std::get_if<DocumentError>(&text)) {
        return *error;
    }
    return readText(std::get<std::string>(text), file.string(), read, warnings);
}

}  // namespace ktr::documents
