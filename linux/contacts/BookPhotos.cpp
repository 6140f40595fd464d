#include "linux/contacts/BookPhotos.h"

#include <QByteArray>
#include <QUrl>
#include <algorithm>
#include <cstdlib>
#include <optional>
#include <variant>

#include "documents/FileReader.h"
#include "platform/base/Utf8.h"

namespace ktr::linux_ {

namespace {

namespace fs = std::filesystem;

std::optional<fs::path> folderOf(const char* variable, const char* inHome) {
    const char* set = std::getenv(variable);
    if (set != nullptr && *set == '/') {
        return fs::path(set);
    }
    const char* home = std::getenv("HOME");
    return home != nullptr && *home == '/' ? std::optional(fs::path(home) / inHome) : std::nullopt;
}

/// Where symbolic links and dots have been followed: none where there is nothing.
std::optional<fs::path> realPath(const fs::path& path) {
    std::error_code failed;
    fs::path real = fs::canonical(path, failed);
    return failed ? std::nullopt : std::optional(std::move(real));
}

bool isIn(const fs::path& file, const fs::path& folder) {
    const auto [at, rest] = std::mismatch(folder.begin(), folder.end(), file.begin(), file.end());
    return at == folder.end() && rest != file.end();
}

/// A property's logical line from `at` on, with its folds; where the next one begins.
std::size_t endOfLine(std::string_view text, std::size_t at) {
    while (at < text.size()) {
        const std::size_t end = text.find('\n', at);
        if (end == std::string_view::npos) {
            return text.size();
        }
        at = end + 1;
        if (at >= text.size() || (text[at] != ' ' && text[at] != '\t')) {
            return at;
        }
    }
    return text.size();
}

std::string unfolded(std::string_view line) {
    std::string out;
    for (std::size_t i = 0; i < line.size(); ++i) {
        if (line[i] == '\r') {
            continue;
        }
        if (line[i] == '\n') {
            ++i;  // and the blank that marks the fold
            continue;
        }
        out += line[i];
    }
    return out;
}

/// The bytes of the photo that a property names; none for one that is not a file in these folders.
std::optional<std::string> photoOf(const std::string& property, const std::vector<fs::path>& folders) {
    const auto colon = property.find(':');
    const std::string parameters = platform::asciiLowercased(property.substr(0, colon));
    if (colon == std::string::npos || parameters.find("value=uri") == std::string::npos) {
        return std::nullopt;
    }
    const QUrl url(QString::fromStdString(property.substr(colon + 1)));
    const auto file = url.isLocalFile() ? realPath(url.toLocalFile().toStdString()) : std::nullopt;
    const bool isOwn = file && std::any_of(folders.begin(), folders.end(), [&](const fs::path& folder) {
                           const auto real = realPath(folder);
                           return real && isIn(*file, *real);
                       });
    if (!isOwn) {
        return std::nullopt;
    }
    const auto read = documents::FileReader::read(*file, {BookPhotos::kLargest, {}});
    const auto* bytes = std::get_if<std::string>(&read);
    return bytes != nullptr ? std::optional(*bytes) : std::nullopt;
}

}  // namespace

std::vector<fs::path> BookPhotos::folders() {
    std::vector<fs::path> folders;
    for (const auto& base : {folderOf("XDG_DATA_HOME", ".local/share"), folderOf("XDG_CACHE_HOME", ".cache")}) {
        if (base) {
            folders.push_back(*base / "evolution" / "addressbook");
        }
    }
    return folders;
}

std::string BookPhotos::withPhotos(std::string_view cards, const std::vector<fs::path>& folders) {
    std::string out;
    out.reserve(cards.size());
    for (std::size_t at = 0; at < cards.size();) {
        const std::size_t next = endOfLine(cards, at);
        const std::string_view line = cards.substr(at, next - at);
        at = next;
        const auto photo =
            platform::asciiLowercased(line.substr(0, 6)) == "photo;" ? photoOf(unfolded(line), folders) : std::nullopt;
        if (photo) {
            out += "PHOTO;ENCODING=b:";
            out += QByteArray::fromStdString(*photo).toBase64().toStdString();
            out += "\r\n";
        } else {
            out += line;
        }
    }
    return out;
}

}  // namespace ktr::linux_
