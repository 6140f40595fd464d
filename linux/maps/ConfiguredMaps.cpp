#include "linux/maps/ConfiguredMaps.h"

#include "linux/configuration/XdgFolders.h"
#include "linux/maps/AttributedGround.h"
#include "linux/maps/FolderGround.h"
#include "linux/maps/HttpsPictures.h"
#include "linux/maps/MainlandArea.h"
#include "linux/maps/MbtilesPictures.h"
#include "linux/maps/PictureGround.h"
#include "linux/maps/VectorGround.h"
#include "linux/maps/WorldGround.h"

namespace ktr::linux_ {

namespace {

void addSource(ThreadedMapSource::Grounds& grounds, const Configuration::Maps::Source& source,
               const Configuration& configuration, const std::shared_ptr<NetworkThread>& network) {
    if (!source.url.empty()) {
        HttpsPictures::Settings settings;
        settings.url = source.url;
        settings.attribution = source.attribution.value_or("");
        settings.coarsest = source.coarsest;
        settings.finest = source.finest;
        settings.cacheFolder = XdgFolders::cache() / "tiles";
        settings.cacheBytes = static_cast<std::uint64_t>(configuration.maps.cacheMegabytes) << 20;
        settings.certificateFiles = configuration.certificates;
        grounds.push_back(
            std::make_shared<PictureGround>(std::make_unique<HttpsPictures>(std::move(settings), network)));
        return;
    }
    // Only the file itself says which of the two it is: the other one finds nothing in it.
    ThreadedMapSource::Grounds both = {std::make_shared<VectorGround>(source.file),
                                       std::make_shared<PictureGround>(std::make_unique<MbtilesPictures>(source.file))};
    for (auto& ground : both) {
        grounds.push_back(source.attribution ? std::make_shared<AttributedGround>(ground, *source.attribution)
                                             : ground);
    }
}

}  // namespace

std::shared_ptr<ThreadedMapSource> ConfiguredMaps::make(const Configuration& configuration,
                                                        const std::filesystem::path& resourceFolder,
                                                        std::shared_ptr<platform::MainLoop> mainLoop,
                                                        const std::shared_ptr<NetworkThread>& network) {
    std::shared_ptr<const MainlandArea> gcj02;
    if (configuration.maps.datum == Configuration::Maps::Datum::Gcj02) {
        if (const auto world = WorldMap::readOrReport(resourceFolder / "maps" / "world.bin",
                                                      "No place is shifted for maps in GCJ-02")) {
            gcj02 = std::make_shared<MainlandArea>(world->outline());
        }
    }
    return std::make_shared<ThreadedMapSource>(std::move(mainLoop), grounds(configuration, resourceFolder, network),
                                               std::move(gcj02));
}

ThreadedMapSource::Grounds ConfiguredMaps::grounds(const Configuration& configuration,
                                                   const std::filesystem::path& resourceFolder,
                                                   const std::shared_ptr<NetworkThread>& network) {
    const auto folder = resourceFolder / "maps";
    ThreadedMapSource::Grounds grounds = {std::make_shared<VectorGround>((folder / "brinmouth.mbtiles").string())};
    for (const Configuration::Maps::Source& source : configuration.maps.sources) {
        addSource(grounds, source, configuration, network);
    }
    grounds.push_back(std::make_shared<FolderGround>(XdgFolders::data() / "maps"));
    grounds.push_back(std::make_shared<WorldGround>(folder / "world.bin"));
    return grounds;
}

}  // namespace ktr::linux_
