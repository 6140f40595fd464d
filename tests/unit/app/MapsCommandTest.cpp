#include "app/MapsCommand.h"

#include <sys/stat.h>

#include <fstream>

#include "tests/support/EnvironmentVariable.h"
#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

namespace ktr::app {

namespace {

class MapsCommandTest : public ::testing::Test {
  protected:
    static host::ExitCode add(const std::filesystem::path& file, std::string* said = nullptr) {
        ::testing::internal::CaptureStdout();
        ::testing::internal::CaptureStderr();
        const auto code = MapsCommand::add(file.string());
        const std::string out = ::testing::internal::GetCapturedStdout();
        const std::string error = ::testing::internal::GetCapturedStderr();
        if (said != nullptr) {
            *said = out + error;
        }
        return code;
    }

    test::TemporaryFolder folder;
    test::EnvironmentVariable data{"XDG_DATA_HOME", (folder.path() / "data").c_str()};
    std::filesystem::path maps = folder.path() / "data" / "ktr" / "maps";
    std::filesystem::path town = KTR_RESOURCES "/maps/brinmouth.mbtiles";
};

TEST_F(MapsCommandTest, AMapIsLinked_AndWhatItCoversIsSaid_Twice) {
    for (int time = 0; time < 2; ++time) {
        std::string said;
        EXPECT_EQ(add(town, &said), host::ExitCode::Ok) << said;
        EXPECT_NE(said.find("brinmouth.mbtiles: streets"), std::string::npos) << said;
        EXPECT_NE(said.find("levels "), std::string::npos) << said;
        EXPECT_TRUE(std::filesystem::is_symlink(maps / "brinmouth.mbtiles"));
        EXPECT_TRUE(std::filesystem::equivalent(maps / "brinmouth.mbtiles", town));
    }
    EXPECT_EQ(add(maps / "brinmouth.mbtiles"), host::ExitCode::Ok);
    EXPECT_TRUE(std::filesystem::equivalent(maps / "brinmouth.mbtiles", town));
}

TEST_F(MapsCommandTest, WhatIsNoMapIsRefused_AndNothingIsLeftBehind) {
    const auto text = folder.path() / "text.mbtiles";
    std::ofstream(text) << "no map";
    const auto pipe = folder.path() / "pipe.mbtiles";
    ASSERT_EQ(mkfifo(pipe.c_str(), 0600), 0);
    for (const auto& file : {text, pipe, folder.path(), folder.path() / "missing.mbtiles"}) {
        std::string said;
        EXPECT_EQ(add(file, &said), host::ExitCode::Failure) << file;
        EXPECT_FALSE(said.empty());
    }
    EXPECT_FALSE(std::filesystem::exists(maps));
}

}  // namespace

}  // namespace ktr::app
