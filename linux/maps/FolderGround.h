#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "linux/maps/MapGround.h"

namespace ktr::linux_ {

/// Draws from all MBTiles files in a folder, in the order of their names: what somebody puts there is a map from the
/// next picture on, and what they take away is none. A folder that is not there has no maps.
class FolderGround final : public MapGround {
  public:
    /// Of more files the first ones are used.
    static constexpr std::size_t kMostFiles = 64;

    explicit FolderGround(std::filesystem::path folder) : folder_(std::move(folder)) {}
    /// The maps in a folder, in the order in which they are drawn. It looks at the disk.
    static std::vector<std::filesystem::path> filesIn(const std::filesystem::path& folder);
    MapDrawn draw(const MapDrawing& drawing) override;
    /// Tells when maps come into the folder, or go.
    void setChangeHandler(std::function<void()> changed) override;

  private:
    struct File {
        std::filesystem::path path;
        /// Vector tiles and pictures: only the file itself says which it has, and the other finds nothing in it.
        std::vector<std::shared_ptr<MapGround>> grounds;
    };
    class Follower;
    void list();

    const std::filesystem::path folder_;
    std::vector<File> files_;
    /// Of the main thread, where it also ends: a ground may end on a worker.
    std::shared_ptr<Follower> follower_;
};

}  // namespace ktr::linux_
