#include "linux/configuration/TokenFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <utility>

namespace ktr::linux_ {

namespace {

constexpr std::size_t kLongestToken = std::size_t{16} * 1024;

std::string refusal(const struct stat& facts) {
    if (!S_ISREG(facts.st_mode)) {
        return "is no regular file";
    }
    if (facts.st_uid != ::geteuid()) {
        return "belongs to another user";
    }
    if ((facts.st_mode & 077U) != 0) {
        std::array<char, 8> mode{};
        std::snprintf(mode.data(), mode.size(), "%04o", static_cast<unsigned>(facts.st_mode & 07777U));
        return std::string("has mode ") + mode.data() +
               ", so that others can reach it; make it private with: chmod 600";
    }
    return "";
}

/// False on a read error.
bool readAll(int descriptor, std::string& token) {
    std::array<char, 4096> block{};
    while (token.size() <= kLongestToken) {
        const ssize_t count = ::read(descriptor, block.data(), block.size());
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count <= 0) {
            return count == 0;
        }
        token.append(block.data(), static_cast<std::size_t>(count));
    }
    return true;
}

}  // namespace

std::variant<std::string, TokenFile::Error> TokenFile::read(const std::filesystem::path& file) {
    // Not blocking: a FIFO in the file's place must not hold the program up.
    const int descriptor = ::open(file.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
    if (descriptor < 0) {
        return Error{errno == ENOENT, file.string() + ": cannot be read: " + std::strerror(errno)};
    }
    struct stat facts {};
    std::string token;
    std::string problem = ::fstat(descriptor, &facts) == 0 ? refusal(facts) : std::strerror(errno);
    if (problem.empty() && !readAll(descriptor, token)) {
        problem = std::strerror(errno);
    }
    ::close(descriptor);
    if (!problem.empty()) {
        return Error{false, file.string() + ": the token file is refused: it " + problem};
    }
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
