#include "linux/configuration/TokenFile.h"

#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <utility>

#include "documents/FileReader.h"

namespace ktr::linux_ {

namespace {

constexpr std::size_t kLongestToken = std::size_t{16} * 1024;

std::string refusal(const struct stat& facts) {
    if (facts.st_uid != ::geteuid()) {
        return "it belongs to another user";
    }
    if ((facts.st_mode & 077U) != 0) {
        std::array<char, 8> mode{};
        std::snprintf(mode.data(), mode.size(), "%04o", static_cast<unsigned>(facts.st_mode & 07777U));
        return std::string("it has mode ") + mode.data() +
               ", so that others can reach it; make it private with: chmod 600";
    }
    return "";
}

}  // namespace

std::variant<std::string, TokenFile::Error> TokenFile::read(const std::filesystem::path& file) {
    auto read = documents::FileReader::read(file, {kLongestToken + 1, refusal});
    if (const auto* error = std::get_if<documents::FileReader::Error>(&read)) {
        return Error{error->isMissing, file.string() + ": the app token cannot be taken from here: " + error->reason};
    }
    auto& token = std::get<std::string>(read);
    if (auto line = tokenIn(std::move(token))) {
        return *std::move(line);
    }
    return Error{false, file.string() + ": expected one line of at most 16 KiB that holds the app token"};
}

std::optional<std::string> TokenFile::tokenIn(std::string text) {
    while (!text.empty() && (text.back() == '\n' || text.back() == '\r')) {
        text.pop_back();
    }
    const bool control =
        std::any_of(text.begin(), text.end(), [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; });
    return text.empty() || control || text.size() > kLongestToken ? std::nullopt : std::optional(std::move(text));
}

}  // namespace ktr::linux_
