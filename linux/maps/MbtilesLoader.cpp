#include "linux/maps/MbtilesLoader.h"

#include <filesystem>
#include <string>
#include <system_error>

#include "linux/device/LoadableModule.h"
#include "linux/maps/MbtilesModule.h"

namespace ktr::linux_ {

namespace {

/// Why a database is not opened; empty when it may be. A pipe would be waited for, also in the place of one of the
/// files that the library looks for beside the database, wherever a link to it leads.
std::string objection(const std::string& path) {
    std::error_code failed;
    const std::filesystem::path file = std::filesystem::canonical(path, failed);
    if (failed) {
        return failed.message();
    }
    if (!std::filesystem::is_regular_file(file, failed)) {
        return failed ? failed.message() : "not a file";
    }
    for (const char* end : {"-journal", "-wal", "-shm"}) {
        const std::string beside = file.string() + end;
        if (std::filesystem::exists(beside, failed) && !std::filesystem::is_regular_file(beside, failed)) {
            return "not a file: " + beside;
        }
    }
    return "";
}

}  // namespace

std::shared_ptr<tiles::MbtilesFile> MbtilesLoader::open(const std::string& path, std::string& error) {
    struct Module {
        MbtilesModuleEntry open = nullptr;
        std::string error;
    };
    static const Module loaded = [] {
        Module made;
        made.open = reinterpret_cast<MbtilesModuleEntry>(
            LoadableModule::entry("libktr-mbtiles.so", kMbtilesModuleEntry, made.error));
        return made;
    }();
    if (!loaded.open) {
        error = loaded.error;
        return nullptr;
    }
    if (error = objection(path); !error.empty()) {
        return nullptr;
    }
    std::shared_ptr<tiles::MbtilesFile> file;
    return loaded.open(path, file, error) ? file : nullptr;
}

}  // namespace ktr::linux_
