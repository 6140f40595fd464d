#include "app/AddedMaps.h"

#include <sys/stat.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "tests/support/EnvironmentVariable.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/maps/MbtilesWriter.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

class AddedMapsTest : public ::testing::Test {
  protected:
    AddedMapsTest() { std::filesystem::create_directories(maps); }
    /// Puts a map there that says that it is called so.
    void put(const std::string& file, const std::string& name) const {
        test::MbtilesWriter writer((maps / file).string());
        writer.makeTables();
        if (!name.empty()) {
            writer.putMetadata("name", name);
        }
        writer.putTile({0, 0, 0}, "tile");
    }
    static std::vector<std::string> names() {
        std::vector<std::string> names;
        for (const auto& map : AddedMaps::list()) {
            names.push_back(map.name);
        }
        return names;
    }
    using Names = std::vector<std::string>;

    test::TemporaryFolder folder;
    test::EnvironmentVariable data{"XDG_DATA_HOME", (folder.path() / "data").c_str()};
    const std::filesystem::path maps = folder.path() / "data" / "ktr" / "maps";
};

}  // namespace

TEST_F(AddedMapsTest, AMapIsCalledWhatItSaysItIs_OneThatSaysNothingAsItsFile) {
    put("a.mbtiles", "Zealand");
    put("b.mbtiles", "");
    put("c.mbtiles", " \t ");
    put("d.mbtiles", "The <b>Bay</b> &amp; its islands");
    EXPECT_EQ(names(), (Names{"The Bay & its islands", "Zealand", "b", "c"}));
}

TEST_F(AddedMapsTest, WhatCannotBeRead_IsListedAsItsFile_SoThatItCanBeTakenAway) {
    std::ofstream(maps / "text.mbtiles") << "no map";
    ASSERT_EQ(mkfifo((maps / "pipe.mbtiles").c_str(), 0600), 0);
    std::filesystem::create_directory(maps / "folder.mbtiles");
    std::filesystem::create_symlink(maps / "nowhere", maps / "gone.mbtiles");
    EXPECT_EQ(names(), (Names{"folder", "gone", "pipe", "text"}));
}

TEST_F(AddedMapsTest, AHostileName_IsOneShortLineThatTurnsNothingAround) {
    put("a.mbtiles", "Bay\n\x1b[31m\u202Egnp.exe\u2066");
    put("b.mbtiles", std::string(100000, 'w'));
    put("evil\u202E\n.mbtiles", "");
    EXPECT_EQ(names(), (Names{"Bay [31m gnp.exe", "evil", std::string(120, 'w')}));
}

TEST_F(AddedMapsTest, SeveralOfTheSameName_AreToldApartByTheirFiles) {
    put("north.mbtiles", "Streets");
    put("south.mbtiles", "Streets");
    put("Streets.mbtiles", "Streets");
    put("bay.mbtiles", "The bay");
    EXPECT_EQ(names(), (Names{"Streets", "Streets (north)", "Streets (south)", "The bay"}));
}

}  // namespace ktr::app
