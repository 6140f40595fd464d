#include "linux/configuration/PreferencesFile.h"

#include <QByteArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QString>
#include <cerrno>
#include <cstring>
#include <fstream>
#include <iterator>

#include "documents/AtomicFile.h"
#include "documents/FileLock.h"
#include "platform/base/Json.h"
#include "platform/base/Value.h"

namespace ktr::linux_ {

namespace {

namespace fs = std::filesystem;
using Texts = PreferencesFile::Texts;

/// None for what is no object of texts.
std::optional<Texts> parse(const std::string& text) {
    QJsonParseError error;
    const QJsonDocument document = QJsonDocument::fromJson(QByteArray::fromStdString(text), &error);
    if (!document.isObject()) {
        return std::nullopt;
    }
    Texts texts;
    const QJsonObject object = document.object();
    for (auto member = object.begin(); member != object.end(); ++member) {
        if (!member.value().isString()) {
            return std::nullopt;
        }
        texts[member.key().toStdString()] = member.value().toString().toStdString();
    }
    return texts;
}

std::string written(const Texts& texts) {
    platform::Dictionary object;
    for (const auto& [key, value] : texts) {
        object.set(key, value);
    }
    return platform::writeJson(object) + "\n";
}

/// The file's bytes, empty for no file; or why it cannot be read.
std::variant<std::string, PreferencesFile::Error> bytesOf(const fs::path& file, bool& exists) {
    std::error_code failure;
    const fs::file_type type = fs::status(file, failure).type();
    exists = type != fs::file_type::not_found;
    if (!exists) {
        return std::string();
    }
    // Not even opened: a FIFO in the file's place would hold the program up.
    if (type != fs::file_type::regular) {
        const std::string reason = failure ? failure.message() : "it is no regular file";
        return PreferencesFile::Error{file.string() + ": cannot be read: " + reason};
    }
    errno = 0;
    std::ifstream stream(file, std::ios::binary);
    std::string bytes{std::istreambuf_iterator<char>(stream), {}};
    if (!stream.is_open() || stream.bad()) {
        return PreferencesFile::Error{file.string() + ": cannot be read: " + std::strerror(errno != 0 ? errno : EIO)};
    }
    return bytes;
}

}  // namespace

std::variant<Texts, PreferencesFile::Error> PreferencesFile::read(const fs::path& file) {
    bool exists = false;
    const auto bytes = bytesOf(file, exists);
    if (const auto* error = std::get_if<Error>(&bytes)) {
        return *error;
    }
    if (!exists) {
        return Texts();
    }
    auto texts = parse(std::get<std::string>(bytes));
    if (!texts) {
        return Error{file.string() + ": expected a JSON object of texts"};
    }
    return *texts;
}

std::variant<Texts, PreferencesFile::Error> PreferencesFile::merge(const fs::path& file, const Changes& changes) {
    if (auto failure = documents::AtomicFile::makeFolder(file.parent_path()); !failure.empty()) {
        return Error{failure};
    }
    fs::path lockFile = file;
    lockFile += ".lock";
    const documents::FileLock lock(lockFile);
    if (!lock.isHeld()) {
        return Error{file.string() + ": cannot be locked: " + std::strerror(errno)};
    }
    bool exists = false;
    const auto bytes = bytesOf(file, exists);
    if (const auto* error = std::get_if<Error>(&bytes)) {
        return *error;
    }
    auto stored = exists ? parse(std::get<std::string>(bytes)) : Texts();
    if (!stored) {
        fs::path broken = file;
        broken += ".broken";
        std::error_code failure;
        fs::rename(file, broken, failure);
        if (failure) {
            return Error{file.string() + ": expected a JSON object of texts"};
        }
        stored = Texts();
    }
    Texts texts = *stored;
    for (const auto& [key, value] : changes) {
        if (value) {
            texts[key] = *value;
        } else {
            texts.erase(key);
        }
    }
    if (texts != *stored) {
        if (auto failure = documents::AtomicFile::write(file, written(texts)); !failure.empty()) {
            return Error{failure};
        }
    }
    return texts;
}

}  // namespace ktr::linux_
