#include <exception>

#include "linux/maps/MbtilesModule.h"
#include "tiles/MbtilesIndex.h"
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

extern "C" __attribute__((visibility("default"))) bool ktrIndexMbtiles(const std::string& from, const std::string& to,
                                                                       bool& isCopied, std::string& error) {
    using ktr::tiles::MbtilesIndex;
    isCopied = false;
    try {
        switch (MbtilesIndex::stateOf(from)) {
            case MbtilesIndex::State::Indexed:
                return true;
            case MbtilesIndex::State::Unreadable:
                error = "it cannot be read";
                return false;
            case MbtilesIndex::State::Unindexed:
                error = MbtilesIndex::copyIndexed(from, to);
                isCopied = error.empty();
        }
    } catch (const std::exception& failure) {
        error = failure.what();
    }
    return error.empty();
}
