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

std::string MbtilesLoader::index(const std::string& from, const std::string& to, bool& isCopied) {
    std::string error;
    const auto entry =
        reinterpret_cast<MbtilesKeepEntry>(LoadableModule::entry("libktr-mbtiles.so", kMbtilesKeepEntry, error));
    if (entry != nullptr && error.empty()) {
        entry(from, to, isCopied, error);
    }
    return error;
}

}  // namespace ktr::linux_
