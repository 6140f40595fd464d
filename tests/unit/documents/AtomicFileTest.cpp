#include "documents/AtomicFile.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using documents::AtomicFile;

class AtomicFileTest : public ::testing::Test {
  protected:
    std::filesystem::path path(const char* name) const { return folder.path() / name; }
    TemporaryFolder folder;
};

TEST_F(AtomicFileTest, Pipe_IsNotReplaced) {
    ASSERT_EQ(::mkfifo(path("pipe").c_str(), 0600), 0);
    EXPECT_NE(AtomicFile::write(path("pipe"), "new").find("this is a pipe"), std::string::npos);
    EXPECT_TRUE(std::filesystem::is_fifo(path("pipe")));
    EXPECT_FALSE(std::filesystem::exists(path("pipe.new")));
}

TEST_F(AtomicFileTest, Folder_IsNotReplaced) {
    ASSERT_TRUE(std::filesystem::create_directory(path("folder")));
    EXPECT_NE(AtomicFile::write(path("folder"), "new").find("this is a folder"), std::string::npos);
    EXPECT_FALSE(std::filesystem::exists(path("folder.new")));
}

TEST_F(AtomicFileTest, Link_IsReplacedItself) {
    ASSERT_EQ(::mkfifo(path("pipe").c_str(), 0600), 0);
    std::filesystem::create_symlink(path("pipe"), path("link"));
    EXPECT_EQ(AtomicFile::write(path("link"), "new"), "");
    EXPECT_TRUE(std::filesystem::is_fifo(path("pipe")));
    EXPECT_TRUE(std::filesystem::is_regular_file(std::filesystem::symlink_status(path("link"))));
    EXPECT_EQ(TemporaryFolder::read(path("link")), "new");
}

}  // namespace ktr::test
