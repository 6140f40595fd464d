#include "linux/maps/FolderGround.h"

#include <algorithm>
#include <system_error>

#include "linux/maps/MbtilesPictures.h"
#include "linux/maps/PictureGround.h"
#include "linux/maps/VectorGround.h"

namespace ktr::linux_ {

std::vector<std::filesystem::path> FolderGround::filesIn(const std::filesystem::path& folder) {
    std::vector<std::filesystem::path> paths;
    std::error_code failed;
    for (std::filesystem::directory_iterator entry(folder, failed), end; !failed && entry != end;
         entry.increment(failed)) {
        if (entry->path().extension() == ".mbtiles") {
            paths.push_back(entry->path());
        }
    }
    std::sort(paths.begin(), paths.end());
    paths.resize(std::min(paths.size(), kMostFiles));
    return paths;
}

void FolderGround::list() {
    std::vector<File> files;
    for (const auto& path : filesIn(folder_)) {
        const auto known =
            std::find_if(files_.begin(), files_.end(), [&](const File& file) { return file.path == path; });
        if (known != files_.end()) {
            files.push_back(*known);
        } else {
            files.push_back({path,
                             {std::make_shared<VectorGround>(path.string()),
                              std::make_shared<PictureGround>(std::make_unique<MbtilesPictures>(path.string()))}});
        }
    }
    files_ = std::move(files);
}

void FolderGround::setChangeHandler(std::function<void()> changed) {
    changed_ = std::move(changed);
    watch_ = std::make_unique<FileWatch>([this] { follow(); });
    follow();
}

/// The folder may come later, and so may those that it stands in.
void FolderGround::follow() {
    const auto above = folder_.parent_path();
    watch_->watch({folder_ / "maps", folder_, above, above.parent_path()}, [this](bool) { look(); });
}

/// What else changes beside the folder draws nothing anew.
void FolderGround::look() {
    aside_.run([this, folder = folder_]() -> Aside::Then {
        return [this, files = filesIn(folder)] {
            const bool isOther = told_ && *told_ != files;
            told_ = files;
            if (isOther && changed_) {
                changed_();
            }
        };
    });
}

MapDrawn FolderGround::draw(const MapDrawing& drawing) {
    list();
    MapDrawn all;
    QRegion left = drawing.region;
    for (const File& file : files_) {
        for (const auto& ground : file.grounds) {
            if (left.isEmpty() || drawing.stop.stop_requested()) {
                return all;
            }
            drawing.painter.save();
            const MapDrawn drawn =
                ground->draw({drawing.request, drawing.painter, drawing.labels, drawing.pixels, left, drawing.stop});
            drawing.painter.restore();
            const QRegion filled = drawn.filled & left;
            left -= filled;
            all.filled += filled;
            all.isComplete = all.isComplete && drawn.isComplete;
            if (!filled.isEmpty() && !drawn.attribution.empty() &&
                all.attribution.find(drawn.attribution) == std::string::npos) {
                all.attribution += (all.attribution.empty() ? "" : " · ") + drawn.attribution;
            }
        }
    }
    return all;
}

}  // namespace ktr::linux_
