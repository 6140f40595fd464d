#include "documents/StagedFiles.h"

#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using documents::StagedFiles;

class StagedFilesTest : public ::testing::Test {
  protected:
    std::filesystem::path path(const char* name) const { return folder.path() / name; }
    std::string textOf(const char* name) const { return TemporaryFolder::read(path(name)); }
    std::size_t count() const {
        return static_cast<std::size_t>(
            std::distance(std::filesystem::directory_iterator(folder.path()), std::filesystem::directory_iterator()));
    }
    TemporaryFolder folder;
};

TEST_F(StagedFilesTest, Files_TakeTheirPlacesAtTheCommit) {
    folder.write("old.png", "old", 0640);
    StagedFiles files;
    ASSERT_EQ(files.add(path("old.png"), "new"), "");
    ASSERT_EQ(files.add(path("fresh.png"), "fresh"), "");
    EXPECT_EQ(textOf("old.png"), "old");
    EXPECT_FALSE(std::filesystem::exists(path("fresh.png")));
    ASSERT_EQ(files.commit(), "");
    EXPECT_EQ(textOf("old.png"), "new");
    EXPECT_EQ(textOf("fresh.png"), "fresh");
    EXPECT_EQ(count(), 2U);
    EXPECT_EQ(std::filesystem::status(path("old.png")).permissions(), std::filesystem::perms(0640));
}

TEST_F(StagedFilesTest, WithoutACommit_NothingHappened) {
    folder.write("a.png", "old");
    {
        StagedFiles files;
        ASSERT_EQ(files.add(path("a.png"), "new"), "");
        ASSERT_EQ(files.add(path("b.png"), "new"), "");
        EXPECT_EQ(count(), 3U);
    }
    EXPECT_EQ(count(), 1U);
    EXPECT_EQ(textOf("a.png"), "old");
}

TEST_F(StagedFilesTest, OneThatCannotTakeItsPlace_BringsAllBack) {
    folder.write("a.png", "old a");
    {
        StagedFiles files;
        ASSERT_EQ(files.add(path("a.png"), "new a"), "");
        ASSERT_EQ(files.add(path("b.png"), "new b"), "");
        ASSERT_EQ(files.add(path("c.png"), "new c"), "");
        // Somebody makes a folder there meanwhile.
        std::filesystem::create_directory(path("c.png"));
        EXPECT_EQ(files.commit().rfind(path("c.png").string() + ": cannot be replaced: ", 0), 0U);
    }
    EXPECT_EQ(textOf("a.png"), "old a");
    EXPECT_FALSE(std::filesystem::exists(path("b.png")));
    EXPECT_EQ(count(), 2U);
}

TEST_F(StagedFilesTest, PipeFolderAndDevice_AreNeverReplaced) {
    ASSERT_EQ(::mkfifo(path("pipe.png").c_str(), 0600), 0);
    std::filesystem::create_directory(path("folder.png"));
    std::filesystem::create_symlink("/dev/null", path("device.png"));
    for (const auto& [name, what] :
         {std::pair("pipe.png", "a pipe"), std::pair("folder.png", "a folder"), std::pair("device.png", "a device")}) {
        StagedFiles files;
        EXPECT_EQ(files.add(path(name), "new"),
                  path(name).string() + ": cannot be written: this is " + what + ", not a file");
        EXPECT_EQ(files.commit(), "");
    }
    struct stat facts {};
    ASSERT_EQ(::stat(path("pipe.png").c_str(), &facts), 0);
    EXPECT_TRUE(S_ISFIFO(facts.st_mode));
    ASSERT_EQ(::stat("/dev/null", &facts), 0);
    EXPECT_TRUE(S_ISCHR(facts.st_mode));
}

TEST_F(StagedFilesTest, Link_IsFollowed) {
    folder.write("real.png", "old");
    std::filesystem::create_symlink("real.png", path("link.png"));
    StagedFiles files;
    ASSERT_EQ(files.add(path("link.png"), "new"), "");
    ASSERT_EQ(files.commit(), "");
    EXPECT_TRUE(std::filesystem::is_symlink(path("link.png")));
    EXPECT_EQ(textOf("real.png"), "new");
}

TEST_F(StagedFilesTest, NoRoom_LeavesTheOldOnesAndNothingElse) {
    folder.write("a.png", "old a");
    folder.write("b.png", "old b");
    const pid_t child = ::fork();
    if (child == 0) {
        std::signal(SIGXFSZ, SIG_IGN);
        const rlimit few{100, 100};
        ::setrlimit(RLIMIT_FSIZE, &few);
        StagedFiles files;
        const bool small = files.add(path("a.png"), "new").empty();
        const auto problem = files.add(path("b.png"), std::string(1000, 'x'));
        ::_exit(small && problem == path("b.png").string() + ": cannot be written: File too large" ? 0 : 1);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    EXPECT_EQ(textOf("a.png"), "old a");
    EXPECT_EQ(textOf("b.png"), "old b");
    // The child ended without its destructors: what it staged is there, under a name that nobody takes for a picture.
    EXPECT_EQ(count(), 3U);
    EXPECT_FALSE(std::filesystem::exists(path("b.png.new")));
}

}  // namespace ktr::test
