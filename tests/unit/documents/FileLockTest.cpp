#include "documents/FileLock.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using documents::FileLock;

TEST(FileLockTest, HeldElsewhere_IsWaitedForNotForEver) {
    const TemporaryFolder folder;
    const FileLock first(folder.path() / "lock");
    ASSERT_TRUE(first.isHeld());
    const auto start = std::chrono::steady_clock::now();
    const FileLock second(folder.path() / "lock", std::chrono::milliseconds(50));
    EXPECT_FALSE(second.isHeld());
    EXPECT_EQ(second.problem(), "another process holds the lock");
    EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::milliseconds(50));
    EXPECT_LE(FileLock::kLongestWait, std::chrono::seconds(10));
}

TEST(FileLockTest, LetGo_IsFree) {
    const TemporaryFolder folder;
    { const FileLock first(folder.path() / "lock"); }
    EXPECT_TRUE(FileLock(folder.path() / "lock", std::chrono::milliseconds(0)).isHeld());
}

TEST(FileLockTest, WhatIsNoFile_IsNoLock) {
    const TemporaryFolder folder;
    ASSERT_EQ(::mkfifo((folder.path() / "pipe").c_str(), 0600), 0);
    EXPECT_EQ(FileLock(folder.path() / "pipe").problem(), "what lies in the lock's place is no file");
    EXPECT_EQ(FileLock(folder.path()).problem(), "Is a directory");
    EXPECT_EQ(FileLock(folder.path() / "none" / "lock").problem(), "No such file or directory");
}

}  // namespace ktr::test
