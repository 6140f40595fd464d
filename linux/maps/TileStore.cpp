#include "linux/maps/TileStore.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cstdio>
#include <fstream>
#include <string_view>
#include <system_error>
#include <vector>

#include "documents/FileReader.h"

namespace ktr::linux_ {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view kFirstLine = "ktr-tile 1";
constexpr std::size_t kLongestHead = 4096;
/// How stale a file's time may be before a use of it is noted there.
constexpr auto kTouch = std::chrono::hours(12);
/// All is counted again after this share of the cap has been written; then a fifth is freed.
constexpr std::uint64_t kShares = 20;

std::string hashOf(const std::string& name) {
    std::uint64_t hash = 0xcbf29ce484222325U;  // FNV-1a
    for (const char c : name) {
        hash = (hash ^ static_cast<unsigned char>(c)) * 0x100000001b3U;
    }
    char text[17];
    std::snprintf(text, sizeof text, "%016llx", static_cast<unsigned long long>(hash));
    return text;
}

std::optional<TileStore::Entry> parsed(const std::string& text) {
    TileStore::Entry entry;
    std::size_t size = 0;
    std::size_t at = 0;
    for (int line = 0; line < 5; ++line) {
        const std::size_t end = text.find('\n', at);
        if (end == std::string::npos || end > kLongestHead) {
            return std::nullopt;
        }
        const std::string value = text.substr(at, end - at);
        at = end + 1;
        const auto number = [&](auto& into) {
            const auto [rest, failure] = std::from_chars(value.data(), value.data() + value.size(), into);
            return failure == std::errc() && rest == value.data() + value.size();
        };
        const bool good = line == 0   ? value == kFirstLine
                          : line == 1 ? number(entry.expires)
                          : line == 2 ? (entry.etag = value, true)
                          : line == 3 ? (entry.modified = value, true)
                                      : number(size);
        if (!good) {
            return std::nullopt;
        }
    }
    if (text.size() - at != size || size == 0 || size > TileStore::kLargestTile) {
        return std::nullopt;
    }
    entry.data.assign(text.begin() + static_cast<std::ptrdiff_t>(at), text.end());
    return entry;
}

/// A field that would break the lines is none.
std::string lineOf(const std::string& field) {
    return field.size() > kLongestHead / 4 || field.find_first_of("\r\n") != std::string::npos ? std::string() : field;
}

}  // namespace

TileStore::TileStore(fs::path root, const std::string& name, std::uint64_t mostBytes)
    : root_(std::move(root)), folder_(root_ / hashOf(name)), mostBytes_(mostBytes) {}

fs::path TileStore::fileOf(const tiles::TileKey& key) const {
    return folder_ / std::to_string(key.z) / std::to_string(key.x) / (std::to_string(key.y) + ".tile");
}

std::optional<TileStore::Entry> TileStore::load(const tiles::TileKey& key) {
    const std::lock_guard lock(mutex_);
    const fs::path file = fileOf(key);
    const auto read = documents::FileReader::read(file, {kLargestTile + kLongestHead, {}});
    const auto* text = std::get_if<std::string>(&read);
    if (text == nullptr) {
        return std::nullopt;
    }
    std::error_code ignored;
    const auto now = fs::file_time_type::clock::now();
    if (now - fs::last_write_time(file, ignored) > kTouch) {
        fs::last_write_time(file, now, ignored);
    }
    return parsed(*text);
}

void TileStore::save(const tiles::TileKey& key, const Entry& entry) {
    if (entry.data.empty() || entry.data.size() > kLargestTile) {
        return;
    }
    const std::lock_guard lock(mutex_);
    const fs::path file = fileOf(key);
    std::error_code failed;
    fs::create_directories(file.parent_path(), failed);
    // Where the user has looked is private.
    fs::permissions(root_, fs::perms::owner_all, failed);
    const fs::path partial = file.string() + ".new";
    {
        std::ofstream stream(partial, std::ios::binary | std::ios::trunc);
        stream << kFirstLine << '\n'
               << entry.expires << '\n'
               << lineOf(entry.etag) << '\n'
               << lineOf(entry.modified) << '\n'
               << entry.data.size() << '\n';
        stream.write(reinterpret_cast<const char*>(entry.data.data()), static_cast<std::streamsize>(entry.data.size()));
        stream.close();
        if (stream.fail()) {
            fs::remove(partial, failed);
            return;
        }
    }
    fs::rename(partial, file, failed);
    written_ += entry.data.size();
    if (!isTrimmed_ || written_ > mostBytes_ / kShares) {
        trim();
    }
}

void TileStore::trim() {
    isTrimmed_ = true;
    written_ = 0;
    struct File {
        fs::path path;
        fs::file_time_type time;
        std::uint64_t size;
    };
    std::vector<File> files;
    std::uint64_t total = 0;
    std::error_code failed;
    for (fs::recursive_directory_iterator at(root_, failed), end; !failed && at != end; at.increment(failed)) {
        std::error_code ignored;
        if (at->is_regular_file(ignored) && !at->is_symlink(ignored)) {
            files.push_back({at->path(), at->last_write_time(ignored), at->file_size(ignored)});
            total += files.back().size;
        }
    }
    if (total <= mostBytes_) {
        return;
    }
    std::sort(files.begin(), files.end(), [](const File& a, const File& b) { return a.time < b.time; });
    for (const File& file : files) {
        if (total <= mostBytes_ - mostBytes_ / 5) {
            break;
        }
        if (fs::remove(file.path, failed)) {
            total -= file.size;
        }
    }
}

}  // namespace ktr::linux_
