#include "documents/FileTrust.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using documents::FileTrust;

class FileTrustTest : public ::testing::Test {
  protected:
    static std::string problemOf(const std::filesystem::path& file) {
        struct stat facts {};
        EXPECT_EQ(::stat(file.c_str(), &facts), 0);
        return FileTrust::problemOf(file, facts);
    }
    void setMode(const std::filesystem::path& path, mode_t mode) { ASSERT_EQ(::chmod(path.c_str(), mode), 0); }

    TemporaryFolder folder;
};

TEST_F(FileTrustTest, OwnFile_IsTrusted) {
    for (const unsigned mode : {0600U, 0644U, 0400U, 0755U}) {
        EXPECT_EQ(problemOf(folder.write("a/b/file", "x", mode)), "");
    }
}

TEST_F(FileTrustTest, FileThatOthersMayWrite_IsNot) {
    for (const unsigned mode : {0666U, 0620U, 0602U}) {
        const auto problem = problemOf(folder.write("file", "x", mode));
        EXPECT_EQ(problem.rfind("others may write it (mode 06", 0), 0U) << problem;
        EXPECT_NE(problem.find("chmod go-w"), std::string::npos);
    }
}

TEST_F(FileTrustTest, FolderThatOthersMayWrite_IsNot_AlsoFurtherUp) {
    const auto file = folder.write("a/b/file", "x");
    setMode(folder.path() / "a", 0777);
    EXPECT_NE(problemOf(file).find("its folder \"" + (folder.path() / "a").string() + "\" (mode 0777)"),
              std::string::npos);
    EXPECT_NE(FileTrust::problemOfFolder(folder.path() / "a"), "");
    // As in /tmp: nobody may replace what is another's.
    setMode(folder.path() / "a", 01777);
    EXPECT_EQ(problemOf(file), "");
    EXPECT_EQ(FileTrust::problemOfFolder(folder.path() / "a"), "");
}

TEST_F(FileTrustTest, Link_IsTrustedOnBothWays) {
    const auto file = folder.write("open/file", "x");
    std::filesystem::create_directory(folder.path() / "own");
    const auto link = folder.path() / "own" / "link";
    std::filesystem::create_symlink(file, link);
    EXPECT_EQ(problemOf(link), "");
    setMode(folder.path() / "open", 0777);
    EXPECT_NE(problemOf(link), "");
    setMode(folder.path() / "open", 0700);
    setMode(folder.path() / "own", 0777);
    EXPECT_NE(problemOf(link), "");
}

TEST_F(FileTrustTest, ForeignFileOrFolder_IsNot) {
    if (::geteuid() != 0) {
        GTEST_SKIP() << "only the administrator can give files away";
    }
    const auto file = folder.write("a/file", "x");
    ASSERT_EQ(::chown(file.c_str(), 12345, 12345), 0);
    EXPECT_EQ(problemOf(file).rfind("it belongs to another user", 0), 0U);
    ASSERT_EQ(::chown(file.c_str(), 0, 0), 0);
    ASSERT_EQ(::chown((folder.path() / "a").c_str(), 12345, 12345), 0);
    EXPECT_NE(problemOf(file).find("belongs to another user"), std::string::npos);
}

}  // namespace ktr::test
