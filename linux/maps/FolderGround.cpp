#include "linux/maps/FolderGround.h"

#include <QObject>
#include <algorithm>
#include <optional>
#include <system_error>
#include <utility>

#include "linux/device/Aside.h"
#include "linux/device/FileWatch.h"
#include "linux/maps/MbtilesPictures.h"
#include "linux/maps/PictureGround.h"
#include "linux/maps/VectorGround.h"

namespace ktr::linux_ {

/// Tells when maps come into a folder, or go. Main thread.
class FolderGround::Follower : public QObject {
  public:
    Follower(std::filesystem::path folder, std::function<void()> changed)
        : folder_(std::move(folder)), changed_(std::move(changed)), watch_([this] { follow(); }), aside_(*this) {
        follow();
    }

  private:
    /// The folder may come later, and so may those that it stands in: what came into a new one before it was watched
    /// is to be watched too.
    void follow() {
        const auto above = folder_.parent_path();
        watch_.watch({folder_ / "maps", folder_, above, above.parent_path()},
                     [this](bool isFolderNew) { isFolderNew ? follow() : look(); });
    }
    /// What else changes beside the folder draws nothing anew.
    void look() {
        aside_.run([this, folder = folder_]() -> Aside::Then {
            return [this, files = filesIn(folder)] {
                const bool isOther = told_ && *told_ != files;
                told_ = files;
                if (isOther) {
                    changed_();
                }
            };
        });
    }

    const std::filesystem::path folder_;
    const std::function<void()> changed_;
    std::optional<std::vector<std::filesystem::path>> told_;  ///< what was there last
    FileWatch watch_;
    Aside aside_;
};

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
    follower_ = std::shared_ptr<Follower>(new Follower(folder_, std::move(changed)),
                                          [](Follower* follower) { follower->deleteLater(); });
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
