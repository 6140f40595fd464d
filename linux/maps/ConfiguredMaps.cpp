#include "linux/maps/ConfiguredMaps.h"

#include "linux/maps/VectorGround.h"
#include "linux/maps/WorldGround.h"

namespace ktr::linux_ {

std::shared_ptr<ThreadedMapSource> ConfiguredMaps::make(const Configuration& configuration,
                                                        const std::filesystem::path& resourceFolder,
                                                        std::shared_ptr<platform::MainLoop> mainLoop) {
    return std::make_shared<ThreadedMapSource>(std::move(mainLoop), grounds(configuration, resourceFolder));
}

ThreadedMapSource::Grounds ConfiguredMaps::grounds(const Configuration& /*configuration*/,
                                                   const std::filesystem::path& resourceFolder) {
    const auto folder = resourceFolder / "maps";
    return {std::make_shared<VectorGround>((folder / "brinmouth.mbtiles").string()),
            std::make_shared<WorldGround>(folder / "world.bin")};
}

}  // namespace ktr::linux_
