#include "documents/FileTrust.h"

#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>

#include "documents/Words.h"

namespace ktr::documents {

namespace {

namespace fs = std::filesystem;

constexpr mode_t kOthersWrite = S_IWGRP | S_IWOTH;

std::string modeOf(const struct stat& facts) {
    std::array<char, 8> mode{};
    std::snprintf(mode.data(), mode.size(), "%04o", static_cast<unsigned>(facts.st_mode & 07777U));
    return mode.data();
}

bool isOurs(const struct stat& facts) {
    return facts.st_uid == ::geteuid() || facts.st_uid == 0;
}

std::string foreign(const std::string& what) {
    return what + " belongs to another user, who could change what is read; use one of your own";
}

/// A folder on the way; the nearest one has to be ours, too.
std::string problemOnTheWay(const fs::path& folder, bool isNearest) {
    const std::string what = "its folder " + inQuotes(folder.string(), 200);
    struct stat facts {};
    if (::stat(folder.c_str(), &facts) != 0) {
        return what + " cannot be looked at: " + std::strerror(errno);
    }
    const bool isSticky = (facts.st_mode & S_ISVTX) != 0;
    if ((facts.st_mode & kOthersWrite) != 0 && !isSticky) {
        return "others may write " + what + " (mode " + modeOf(facts) + "); forbid it with: chmod go-w";
    }
    return isNearest && !isOurs(facts) ? foreign(what) : "";
}

std::string problemUpwards(const fs::path& nearest) {
    for (fs::path folder = nearest;; folder = folder.parent_path()) {
        if (auto problem = problemOnTheWay(folder, folder == nearest); !problem.empty()) {
            return problem;
        }
        if (folder == folder.root_path()) {
            return "";
        }
    }
}

/// By the way that was named and by the one where it really lies, when links lead there.
std::string problemOfWays(const fs::path& named) {
    std::error_code failure;
    const fs::path absolute = fs::absolute(named, failure).lexically_normal();
    if (auto problem = problemUpwards(absolute.parent_path()); !problem.empty()) {
        return problem;
    }
    const fs::path real = fs::canonical(absolute, failure);
    return failure || real == absolute ? "" : problemUpwards(real.parent_path());
}

}  // namespace

std::string FileTrust::problemOf(const fs::path& file, const struct stat& facts) {
    if (!isOurs(facts)) {
        return foreign("it");
    }
    if ((facts.st_mode & kOthersWrite) != 0) {
        return "others may write it (mode " + modeOf(facts) + "); forbid it with: chmod go-w";
    }
    return problemOfWays(file);
}

std::string FileTrust::problemOfFolder(const fs::path& folder) {
    // As the folder of something in it.
    return problemOfWays(folder / "x");
}

}  // namespace ktr::documents
