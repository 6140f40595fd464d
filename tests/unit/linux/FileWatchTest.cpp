#include "linux/device/FileWatch.h"

#include <gtest/gtest.h>

#include <QCoreApplication>
#include <chrono>
#include <fstream>
#include <memory>
#include <optional>
#include <thread>

#include "tests/support/NoMoreFiles.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::linux_ {

/// Whether the system has a watch to give.
enum class System { Watches, HasNoneLeft };

class FileWatchTest : public ::testing::TestWithParam<System> {
  protected:
    void SetUp() override {
        if (GetParam() == System::HasNoneLeft && !test::NoMoreFiles::kIsPossible) {
            GTEST_SKIP() << "not under this sanitizer";
        }
    }
    /// Whether it has come true within twenty seconds.
    template <typename Condition>
    static bool comes(Condition condition) {
        for (int round = 0; round < 4000 && !condition(); ++round) {
            QCoreApplication::processEvents();
            std::this_thread::sleep_for(std::chrono::milliseconds(5));
        }
        return condition();
    }
    static void settle() {
        comes([round = 0]() mutable { return ++round > 20; });
    }
    /// What is told once it watches.
    bool watch(FileWatch::Files files) {
        std::optional<bool> isFolderNew;
        files_->watch(std::move(files), [&](bool isNew) { isFolderNew = isNew; });
        EXPECT_FALSE(isFolderNew.has_value()) << "it looked at the disk at once";
        EXPECT_TRUE(comes([&] { return isFolderNew.has_value(); }));
        return isFolderNew.value_or(false);
    }
    std::unique_ptr<FileWatch> made() {
        std::optional<test::NoMoreFiles> none;
        if (GetParam() == System::HasNoneLeft && test::NoMoreFiles::kIsPossible) {
            none.emplace();
        }
        return std::make_unique<FileWatch>([this] { ++changes; }, std::chrono::milliseconds(20));
    }
    /// In place, as `echo >>` does.
    static void append(const std::filesystem::path& file) { std::ofstream(file, std::ios::app) << "more"; }

    test::TemporaryFolder folder;
    int changes = 0;
    std::unique_ptr<FileWatch> files_ = made();
};

TEST_P(FileWatchTest, FileThatAppears_IsTold) {
    EXPECT_TRUE(watch({folder.path() / "config.json"}));
    settle();
    EXPECT_EQ(changes, 0);
    folder.write("config.json", "{}");
    EXPECT_TRUE(comes([this] { return changes > 0; }));
}

TEST_P(FileWatchTest, FileThatIsReplaced_IsToldAndToBeWatchedAgain) {
    folder.write("config.json", "1");
    watch({folder.path() / "config.json"});
    folder.write("config.json.new", "2");
    std::filesystem::rename(folder.path() / "config.json.new", folder.path() / "config.json");
    EXPECT_TRUE(comes([this] { return changes > 0; }));
    EXPECT_FALSE(watch({folder.path() / "config.json"})) << "the folder is the same";
    settle();
    changes = 0;
    append(folder.path() / "config.json");
    EXPECT_TRUE(comes([this] { return changes > 0; }));
}

// Dotfiles are links into a folder that nobody has named.
TEST_P(FileWatchTest, FileBehindALink_IsToldWhenItIsWritten) {
    test::TemporaryFolder elsewhere;
    elsewhere.write("real.json", "1");
    std::filesystem::create_symlink(elsewhere.path() / "real.json", folder.path() / "config.json");
    watch({folder.path() / "config.json"});
    append(elsewhere.path() / "real.json");
    EXPECT_TRUE(comes([this] { return changes > 0; }));
}

TEST_P(FileWatchTest, FolderThatIsNotThere_IsNewOnceItIs) {
    const auto file = folder.path() / "later" / "token";
    EXPECT_FALSE(watch({file}));
    std::filesystem::create_directory(folder.path() / "later");
    EXPECT_TRUE(watch({file}));
    EXPECT_FALSE(watch({file}));
}

// Programs write all the time into the folders that maps' folder stands in.
TEST_P(FileWatchTest, FolderAmongTheFiles_IsNotFollowedForWhatIsWrittenInIt) {
    if (GetParam() == System::HasNoneLeft) {
        GTEST_SKIP() << "what is looked at every so often wakes nobody";
    }
    std::filesystem::create_directory(folder.path() / "data");
    folder.write("data/one", "1");
    watch({folder.path() / "data"});
    settle();
    changes = 0;
    append(folder.path() / "data" / "one");
    settle();
    EXPECT_EQ(changes, 0);
    std::filesystem::rename(folder.path() / "data", folder.path() / "gone");
    EXPECT_TRUE(comes([this] { return changes > 0; }));
}

TEST_P(FileWatchTest, WhoHasGone_IsToldNothing) {
    auto mine = made();
    bool isTold = false;
    mine->watch({folder.path() / "config.json"}, [&](bool) { isTold = true; });
    mine.reset();
    folder.write("config.json", "{}");
    settle();
    EXPECT_FALSE(isTold);
    EXPECT_EQ(changes, 0);
}

INSTANTIATE_TEST_SUITE_P(EachSystem, FileWatchTest, ::testing::Values(System::Watches, System::HasNoneLeft),
                         [](const auto& tested) {
                             return tested.param == System::Watches ? "Watches" : "HasNoneLeft";
                         });

}  // namespace ktr::linux_
