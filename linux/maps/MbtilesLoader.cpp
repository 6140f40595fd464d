#include "linux/maps/MbtilesLoader.h"

#include <string>

#include "linux/device/LoadableModule.h"
#include "linux/maps/MbtilesModule.h"

namespace ktr::linux_ {

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
    std::shared_ptr<tiles::MbtilesFile> file;
    return loaded.open(path, file, error) ? file : nullptr;
}

}  // namespace ktr::linux_
