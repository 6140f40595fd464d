#include "linux/maps/MbtilesPictures.h"
#include "linux/maps/MbtilesLoader.h"

#include <system_error>

#include "platform/base/LogArea.h"

namespace ktr::linux_ {

namespace {

/// A file that cannot be read is tried again after this.
constexpr auto kRetry = std::chrono::seconds(5);

}  // namespace

bool MbtilesPictures::open() {
    std::error_code failed;
    const auto written = std::filesystem::last_write_time(path_, failed);
    const auto now = std::chrono::steady_clock::now();
    if (looked_ && !failed && written == written_ && (file_ || now - *looked_ < kRetry)) {
        return file_ != nullptr;
    }
    looked_ = now;
    written_ = written;
    ++version_;
    std::string error;
    if (!read(error)) {
        file_.reset();
    }
    if (!error.empty() && error != reported_) {
        platform::areaLog(platform::LogArea::Maps)
            .write(platform::LogLevel::Error, "The map %@ cannot be read: %@", platform::FormatArgument(path_).shown(),
                   platform::FormatArgument(error).shown());
    }
    reported_ = error;
    return file_ != nullptr;
}

bool MbtilesPictures::read(std::string& error) {
    file_ = MbtilesLoader::open(path_, error);
    if (!file_) {
        // Why is said once, by the ground that looks for vector tiles in the same file.
        error.clear();
        return false;
    }
    facts_ = tiles::TilesetFacts::of(file_->metadata());
    if (facts_.format.empty() || facts_.format == "pbf" || facts_.format == "mvt") {
        return false;  // vector tiles: another ground's
    }
    if (facts_.format == "webp" || facts_.format == "image/webp") {
        error = "its pictures are WebP; PNG and JPEG are read";
        return false;
    }
    const auto coarsest = facts_.coarsest ? facts_.coarsest : file_->coarsestLevel();
    const auto finest = facts_.finest ? facts_.finest : file_->finestLevel();
    if (!coarsest || !finest || *coarsest > *finest) {
        error = "no tiles";
        return false;
    }
    coarsest_ = *coarsest;
    finest_ = *finest;
    return true;
}

TilePictures::Answer MbtilesPictures::tile(const tiles::TileKey& key, bool /*isWanted*/) {
    Answer answer;
    answer.version = version_;
    if (file_) {
        answer.data = file_->tile(key);
    }
    return answer;
}

}  // namespace ktr::linux_
