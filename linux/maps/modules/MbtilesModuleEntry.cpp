#include <exception>

#include "linux/maps/MbtilesModule.h"
#include "tiles/SqliteMbtiles.h"

extern "C" __attribute__((visibility("default"))) bool ktrOpenMbtiles(const std::string& path,
                                                                      std::shared_ptr<ktr::tiles::MbtilesFile>& file,
                                                                      std::string& error) {
    try {
        file = ktr::tiles::SqliteMbtiles::open(path, error);
    } catch (const std::exception& failure) {
        error = failure.what();
    }
    return file != nullptr;
}
