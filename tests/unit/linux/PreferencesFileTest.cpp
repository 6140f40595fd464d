#include "linux/configuration/PreferencesFile.h"

#include <gtest/gtest.h>
#include <sched.h>
#include <sys/mount.h>
#include <sys/ptrace.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <csignal>

#include "documents/FileLock.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using linux_::PreferencesFile;

class PreferencesFileTest : public ::testing::Test {
  protected:
    PreferencesFile::Texts read() const {
        const auto texts = PreferencesFile::read(file);
        const auto* error = std::get_if<PreferencesFile::Error>(&texts);
        EXPECT_EQ(error, nullptr) << (error != nullptr ? error->text : "");
        return error != nullptr ? PreferencesFile::Texts() : std::get<PreferencesFile::Texts>(texts);
    }
    bool merge(const PreferencesFile::Changes& changes) const {
        return std::holds_alternative<PreferencesFile::Texts>(PreferencesFile::merge(file, changes));
    }
    /// Runs the merge in a process of its own, and kills that at its `calls`-th entry to or exit from the kernel. False
    /// when it ended before.
    bool mergeAndKill(const PreferencesFile::Changes& changes, int calls) const {
        const pid_t child = ::fork();
        if (child == 0) {
            ::ptrace(PTRACE_TRACEME, 0, nullptr, nullptr);
            ::raise(SIGSTOP);
            ::_exit(merge(changes) ? 0 : 1);
        }
        int status = 0;
        ::waitpid(child, &status, 0);
        for (int i = 0; i < calls; ++i) {
            if (::ptrace(PTRACE_SYSCALL, child, nullptr, nullptr) != 0 || ::waitpid(child, &status, 0) != child) {
                ADD_FAILURE() << "the child cannot be traced";
                return false;
            }
            if (WIFEXITED(status)) {
                EXPECT_EQ(WEXITSTATUS(status), 0);
                return false;
            }
        }
        ::kill(child, SIGKILL);
        ::waitpid(child, &status, 0);
        return true;
    }

    TemporaryFolder folder;
    std::filesystem::path file = folder.path() / "preferences" / "org.ktr.snippets.json";
};

TEST_F(PreferencesFileTest, Changes_AreMergedAndRemoved) {
    EXPECT_TRUE(read().empty());
    EXPECT_TRUE(merge({{"a", "1"}, {"b", "\xC3\xA9\n\""}}));
    EXPECT_TRUE(merge({{"a", std::nullopt}, {"c", ""}}));
    EXPECT_EQ(read(), (PreferencesFile::Texts{{"b", "\xC3\xA9\n\""}, {"c", ""}}));
    struct stat facts {};
    ASSERT_EQ(::stat(file.c_str(), &facts), 0);
    EXPECT_EQ(facts.st_mode & 0777U, 0600U);
}

TEST_F(PreferencesFileTest, KilledAtEveryKernelCall_HoldsTheOldOrTheNew) {
    ASSERT_TRUE(merge({{"host", "old.example"}, {"other", "kept"}}));
    int kills = 0;
    std::string before = "old.example";
    for (int calls = 1; calls < 1000; ++calls) {
        const std::string next = "new" + std::to_string(calls) + ".example";
        const bool killed = mergeAndKill({{"host", next}}, calls);
        const auto texts = read();
        ASSERT_EQ(texts.count("host"), 1U) << calls;
        ASSERT_TRUE(texts.at("host") == before || texts.at("host") == next) << calls << ": " << texts.at("host");
        ASSERT_EQ(texts.at("other"), "kept");
        before = texts.at("host");
        if (!killed) {
            EXPECT_EQ(before, next);
            break;
        }
        ++kills;
    }
    EXPECT_GT(kills, 10);
    EXPECT_LT(kills, 999);
}

TEST_F(PreferencesFileTest, TwoProcesses_LoseNothingOfEachOther) {
    constexpr int kWrites = 40;
    pid_t children[2] = {};
    for (int who = 0; who < 2; ++who) {
        children[who] = ::fork();
        if (children[who] == 0) {
            bool done = true;
            for (int i = 0; i < kWrites; ++i) {
                done = merge({{std::to_string(who) + "-" + std::to_string(i), "x"}}) && done;
            }
            ::_exit(done ? 0 : 1);
        }
    }
    for (const pid_t child : children) {
        int status = 0;
        ASSERT_EQ(::waitpid(child, &status, 0), child);
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    }
    EXPECT_EQ(read().size(), 2U * kWrites);
}

TEST_F(PreferencesFileTest, NoRoomForTheNewFile_LeavesTheOldOne) {
    ASSERT_TRUE(merge({{"host", "old.example"}}));
    const pid_t child = ::fork();
    if (child == 0) {
        std::signal(SIGXFSZ, SIG_IGN);
        const rlimit few{8, 8};
        ::setrlimit(RLIMIT_FSIZE, &few);
        ::_exit(merge({{"host", "new.example"}}) ? 1 : 0);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    EXPECT_EQ(read(), (PreferencesFile::Texts{{"host", "old.example"}}));
    EXPECT_FALSE(std::filesystem::exists(file.string() + ".new"));
    EXPECT_TRUE(merge({{"host", "new.example"}}));
}

TEST_F(PreferencesFileTest, FullDisk_LeavesTheOldOneAndIsOverWithIt) {
    enum Outcome { Good, NoDisk, Written, Lost, NotOver };
    const auto disk = folder.path() / "disk";
    std::filesystem::create_directory(disk);
    const pid_t child = ::fork();
    if (child == 0) {
        // A disk of a few pages of its own; it goes with the process.
        const bool own = ::unshare(CLONE_NEWNS) == 0 || ::unshare(CLONE_NEWUSER | CLONE_NEWNS) == 0;
        if (!own || ::mount(nullptr, "/", nullptr, MS_REC | MS_PRIVATE, nullptr) != 0 ||
            ::mount("tmpfs", disk.c_str(), "tmpfs", 0, "size=64k") != 0) {
            ::_exit(NoDisk);
        }
        file = disk / "preferences.json";
        // Larger than the page that a file may share with what was there before.
        const std::string large(8000, 'x');
        if (!merge({{"host", "old.example"}, {"large", large}})) {
            ::_exit(NoDisk);
        }
        {
            std::ofstream filler(disk / "filler");
            while (filler.write(large.data(), static_cast<std::streamsize>(large.size())) && filler.flush()) {
            }
        }
        if (merge({{"host", "new.example"}})) {
            ::_exit(Written);
        }
        const auto kept = PreferencesFile::read(file);
        const auto* texts = std::get_if<PreferencesFile::Texts>(&kept);
        if (texts == nullptr || *texts != PreferencesFile::Texts{{"host", "old.example"}, {"large", large}}) {
            ::_exit(Lost);
        }
        std::filesystem::remove(disk / "filler");
        ::_exit(merge({{"host", "new.example"}}) && read().at("host") == "new.example" ? Good : NotOver);
    }
    int status = 0;
    ASSERT_EQ(::waitpid(child, &status, 0), child);
    ASSERT_TRUE(WIFEXITED(status));
    if (WEXITSTATUS(status) == NoDisk) {
        GTEST_SKIP() << "no disk of its own may be made here; NoRoomForTheNewFile runs everywhere";
    }
    EXPECT_EQ(WEXITSTATUS(status), Good);
}

TEST_F(PreferencesFileTest, FileThatHoldsNoPreferences_IsPutAside) {
    folder.write("preferences/org.ktr.snippets.json", "{\"host\": \"cut of");
    EXPECT_TRUE(std::holds_alternative<PreferencesFile::Error>(PreferencesFile::read(file)));
    EXPECT_TRUE(merge({{"host", "new.example"}}));
    EXPECT_EQ(read(), (PreferencesFile::Texts{{"host", "new.example"}}));
    EXPECT_EQ(TemporaryFolder::read(file.string() + ".broken"), "{\"host\": \"cut of");
}

TEST_F(PreferencesFileTest, Pipe_IsRefusedAndHoldsNobodyUp) {
    ASSERT_TRUE(std::filesystem::create_directories(file.parent_path()));
    ASSERT_EQ(::mkfifo(file.c_str(), 0600), 0);
    const auto texts = PreferencesFile::read(file);
    ASSERT_TRUE(std::holds_alternative<PreferencesFile::Error>(texts));
    EXPECT_EQ(std::get<PreferencesFile::Error>(texts).text, file.string() + ": this is a pipe, not a file");
    EXPECT_FALSE(merge({{"host", "new.example"}}));
}

TEST_F(PreferencesFileTest, LockHeldElsewhere_IsNotWaitedForWithoutEnd) {
    ASSERT_TRUE(merge({{"host", "old.example"}}));
    const documents::FileLock held(file.string() + ".lock");
    ASSERT_TRUE(held.isHeld());
    const auto start = std::chrono::steady_clock::now();
    const auto merged = PreferencesFile::merge(file, {{"host", "new.example"}});
    ASSERT_TRUE(std::holds_alternative<PreferencesFile::Error>(merged));
    EXPECT_EQ(std::get<PreferencesFile::Error>(merged).text,
              file.string() + ": cannot be locked: another process holds the lock");
    EXPECT_LT(std::chrono::steady_clock::now() - start, 3 * documents::FileLock::kLongestWait);
    EXPECT_EQ(read(), (PreferencesFile::Texts{{"host", "old.example"}}));
}

}  // namespace ktr::test
