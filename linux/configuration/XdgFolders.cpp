#include "linux/configuration/XdgFolders.h"

#include <pwd.h>
#include <unistd.h>

#include <cstdlib>

namespace ktr::linux_ {

namespace {

std::filesystem::path folder(const char* variable, const char* underHome) {
    const char* path = std::getenv(variable);
    const std::filesystem::path base =
        path != nullptr && *path == '/' ? std::filesystem::path(path) : XdgFolders::home() / underHome;
    return base / "ktr";
}

}  // namespace

std::filesystem::path XdgFolders::home() {
    if (const char* path = std::getenv("HOME"); path != nullptr && *path == '/') {
        return path;
    }
    const passwd* entry = ::getpwuid(::geteuid());
    return entry != nullptr && entry->pw_dir != nullptr ? entry->pw_dir : "/";
}

std::filesystem::path XdgFolders::config() {
    return folder("XDG_CONFIG_HOME", ".config");
}

std::filesystem::path XdgFolders::state() {
    return folder("XDG_STATE_HOME", ".local/state");
}

std::filesystem::path XdgFolders::cache() {
    return folder("XDG_CACHE_HOME", ".cache");
}

std::filesystem::path XdgFolders::data() {
    return folder("XDG_DATA_HOME", ".local/share");
}

std::filesystem::path XdgFolders::configurationFile() {
    const char* path = std::getenv("KTR_CONFIG");
    return path != nullptr && *path != '\0' ? std::filesystem::path(path) : config() / "config.json";
}

}  // namespace ktr::linux_
