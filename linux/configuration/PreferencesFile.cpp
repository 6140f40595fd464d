#include "linux/configuration/PreferencesFile.h"

#include <cerrno>
#include <cstring>
#include <utility>

#include "documents/AtomicFile.h"
#include "documents/DocumentReader.h"
#include "documents/FileLock.h"
#include "platform/base/Json.h"
#include "platform/base/Value.h"

namespace ktr::linux_ {

namespace {

namespace fs = std::filesystem;
using Texts = PreferencesFile::Texts;

/// A few texts a domain; more is nothing that this program wrote.
constexpr std::size_t kLargestFile = std::size_t{1} << 20;

std::string written(const Texts& texts) {
    platform::Dictionary object;
    for (const auto& [key, value] : texts) {
        object.set(key, value);
    }
    return platform::writeJson(object) + "\n";
}

std::variant<std::string, documents::DocumentError> bytesOf(const fs::path& file) {
    return documents::DocumentReader::textOf(file, {kLargestFile, {}});
}

}  // namespace

std::variant<Texts, documents::DocumentError> PreferencesFile::readText(const std::string& text, const fs::path& file) {
    Texts texts;
    const auto error = documents::DocumentReader::readText(text, file.string(), [&](documents::FieldReader& members) {
        members.leaveOthers();
        for (const auto& [key, value] : members.dictionary()) {
            if (auto string = members.string(key)) {
                texts[key] = *std::move(string);
            } else if (value.isNull()) {
                members.complain(key, "expected a string, found null");
            }
        }
    });
    return error ? std::variant<Texts, documents::DocumentError>(*error) : std::move(texts);
}

std::variant<Texts, PreferencesFile::Error> PreferencesFile::read(const fs::path& file) {
    const auto bytes = bytesOf(file);
    if (const auto* error = std::get_if<documents::DocumentError>(&bytes)) {
        return error->isMissing ? std::variant<Texts, Error>(Texts()) : Error{error->text()};
    }
    auto texts = readText(std::get<std::string>(bytes), file);
    if (const auto* error = std::get_if<documents::DocumentError>(&texts)) {
        return Error{error->text()};
    }
    return std::get<Texts>(std::move(texts));
}

std::variant<Texts, PreferencesFile::Error> PreferencesFile::merge(const fs::path& file, const Changes& changes) {
    if (auto failure = documents::AtomicFile::makeFolder(file.parent_path()); !failure.empty()) {
        return Error{failure};
    }
    fs::path lockFile = file;
    lockFile += ".lock";
    const documents::FileLock lock(lockFile);
    if (!lock.isHeld()) {
        return Error{file.string() + ": cannot be locked: " + lock.problem()};
    }
    const auto bytes = bytesOf(file);
    Texts stored;
    if (const auto* text = std::get_if<std::string>(&bytes)) {
        auto parsed = readText(*text, file);
        if (auto* texts = std::get_if<Texts>(&parsed)) {
            stored = std::move(*texts);
        } else {
            fs::path broken = file;
            broken += ".broken";
            std::error_code failure;
            fs::rename(file, broken, failure);
            if (failure) {
                return Error{std::get<documents::DocumentError>(parsed).text()};
            }
        }
    } else if (const auto& error = std::get<documents::DocumentError>(bytes); !error.isMissing) {
        return Error{error.text()};
    }
    Texts texts = stored;
    for (const auto& [key, value] : changes) {
        if (value) {
            texts[key] = *value;
        } else {
            texts.erase(key);
        }
    }
    if (texts != stored) {
        if (auto failure = documents::AtomicFile::write(file, written(texts)); !failure.empty()) {
            return Error{failure};
        }
    }
    return texts;
}

}  // namespace ktr::linux_
