#include "host/PluginFinder.h"

#include <cstdlib>
#include <filesystem>

#ifndef KTR_PLUGIN_FOLDER
#define KTR_PLUGIN_FOLDER "/usr/local/lib/ktr"
#endif

namespace ktr::host {

namespace fs = std::filesystem;

std::vector<std::string> PluginFinder::places() {
    const char* const kName = "libktr-snippets.so";
    std::vector<std::string> places;
    std::error_code failure;
    const fs::path program = fs::read_symlink("/proc/self/exe", failure);
    if (!failure) {
        const fs::path folder = program.parent_path();
        places.push_back((folder / kName).string());
        places.push_back((folder.parent_path() / "lib" / kName).string());
        places.push_back((folder.parent_path() / "lib" / "ktr" / kName).string());
    }
    places.push_back((fs::path(KTR_PLUGIN_FOLDER) / kName).string());
    return places;
}

std::string PluginFinder::find(const std::string& asked) {
    if (!asked.empty()) {
        return asked;
    }
    if (const char* environment = std::getenv("KTR_PLUGIN"); environment != nullptr && *environment != '\0') {
        return environment;
    }
    const std::vector<std::string> all = places();
    for (const std::string& place : all) {
        std::error_code failure;
        if (fs::exists(place, failure)) {
            return place;
        }
    }
    return all.front();
}

}  // namespace ktr::host
