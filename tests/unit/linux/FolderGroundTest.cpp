#include "linux/maps/FolderGround.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <chrono>
#include <fstream>
#include <memory>
#include <string>
#include <thread>

#include "tests/support/TemporaryFolder.h"

namespace ktr::linux_ {

namespace {

/// Whether it has come true within twenty seconds.
template <typename Condition>
bool comes(Condition condition) {
    for (int round = 0; round < 20000 && !condition(); ++round) {
        QCoreApplication::processEvents();
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return condition();
}

void put(const std::filesystem::path& map) {
    std::ofstream(map) << "a map";
}

}  // namespace

/// As whoever adds a first map does: folder after folder and then the map, while others look where to watch.
TEST(FolderGroundTest, AMapThatComesWithItsFolders_IsTold_HoweverFastTheyCome) {
    test::TemporaryFolder folder;
    const auto maps = folder.path() / "data" / "ktr" / "maps";
    FolderGround ground(maps);
    // What follows the folder ends with the event loop.
    const auto told = std::make_shared<int>(0);
    ground.setChangeHandler([told] { ++*told; });
    // What is there when it begins to look is not news: one more map at a time, until it looks.
    std::filesystem::create_directories(maps);
    int count = 0;
    ASSERT_TRUE(comes([&] {
        if (*told == 0 && ++count % 100 == 0) {
            put(maps / (std::to_string(count) + ".mbtiles"));
        }
        return *told > 0;
    }));
    for (int round = 0; round < 60; ++round) {
        *told = 0;
        std::filesystem::remove_all(folder.path() / "data");
        ASSERT_TRUE(comes([&] { return *told > 0; })) << "taken away, " << round;
        *told = 0;
        std::thread adds([&, pause = std::chrono::microseconds(round * 20)] {
            for (const auto& made : {maps.parent_path().parent_path(), maps.parent_path(), maps}) {
                std::filesystem::create_directory(made);
                std::this_thread::sleep_for(pause);
            }
            put(maps / "region.mbtiles");
        });
        const bool isTold = comes([&] { return *told > 0; });
        adds.join();
        ASSERT_TRUE(isTold) << round;
    }
}

}  // namespace ktr::linux_
