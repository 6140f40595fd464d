#include "server/service/ServiceLog.h"

#include <fcntl.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <csignal>
#include <string>

#include "tests/support/EnvironmentVariable.h"

namespace ktr::test {

using server::ServiceLog;
using Level = ServiceLog::Level;

class ServiceLogTest : public ::testing::Test {
  protected:
    void SetUp() override { ASSERT_EQ(::pipe2(pipe_, O_NONBLOCK | O_CLOEXEC), 0); }
    void TearDown() override {
        ::close(pipe_[0]);
        ::close(pipe_[1]);
    }
    std::string written() const {
        std::string text;
        char block[65536];
        for (ssize_t count = 0; (count = ::read(pipe_[0], block, sizeof block)) > 0;) {
            text.append(block, static_cast<std::size_t>(count));
        }
        return text;
    }

    int pipe_[2] = {-1, -1};
    const ServiceLog::Clock::time_point start_{};
};

TEST_F(ServiceLogTest, Line_HasTime_Level_EventAndFields) {
    ServiceLog log(pipe_[1]);
    log.write(Level::Warning, "failed", {{"route", ServiceLog::Word("phone")}, {"status", std::int64_t{503}}});
    const std::string line = written();
    EXPECT_EQ(line.substr(0, 7), "time=20");
    EXPECT_EQ(line.substr(line.find(' ')), " level=warning event=failed route=phone status=503\n");
}

TEST_F(ServiceLogTest, Journal_GetsTheLevelInItsOwnWay) {
    struct stat facts {};
    ASSERT_EQ(::fstat(pipe_[1], &facts), 0);
    const std::string name = std::to_string(facts.st_dev) + ":" + std::to_string(facts.st_ino);
    const EnvironmentVariable stream("JOURNAL_STREAM", name.c_str());
    ServiceLog log(pipe_[1]);
    log.write(Level::Error, "store-failing");
    EXPECT_EQ(written(), "<3>level=error event=store-failing\n");
}

TEST_F(ServiceLogTest, FloodOfOneEvent_IsCounted_OthersAreNot) {
    ServiceLog log(pipe_[1]);
    for (int i = 0; i < ServiceLog::kLinesAMinute + 40; ++i) {
        log.write(Level::Info, "refused", {}, start_);
    }
    log.write(Level::Info, "ready", {}, start_);
    const std::string first = written();
    EXPECT_EQ(std::count(first.begin(), first.end(), '\n'), ServiceLog::kLinesAMinute + 1);
    log.write(Level::Info, "refused", {}, start_ + std::chrono::seconds(61));
    EXPECT_NE(written().find("event=refused left_out=40\n"), std::string::npos);
    log.write(Level::Info, "refused", {}, start_ + std::chrono::seconds(62));
    EXPECT_EQ(written().find("left_out"), std::string::npos);
}

TEST_F(ServiceLogTest, PipeThatNobodyReads_IsNotWaitedFor_AndWhatIsLostIsCounted) {
    ::fcntl(pipe_[1], F_SETFL, 0);
    ASSERT_GE(::fcntl(pipe_[1], F_SETPIPE_SZ, 4096), 0);
    ServiceLog log(pipe_[1]);
    for (int i = 0; i < 500; ++i) {
        log.write(Level::Info, "refused", {}, start_ + std::chrono::minutes(i));
    }
    const std::string kept = written();
    const auto lines = std::count(kept.begin(), kept.end(), '\n');
    EXPECT_LT(lines, 500);
    log.write(Level::Info, "refused", {}, start_ + std::chrono::minutes(501));
    EXPECT_NE(written().find("left_out=" + std::to_string(500 - lines) + "\n"), std::string::npos);
}

TEST_F(ServiceLogTest, ClosedPipe_IsNotTheEnd) {
    ServiceLog log(pipe_[1]);
    ::close(pipe_[0]);
    std::signal(SIGPIPE, SIG_IGN);
    log.write(Level::Info, "ready");
    std::signal(SIGPIPE, SIG_DFL);
    ASSERT_EQ(::pipe2(pipe_, O_NONBLOCK | O_CLOEXEC), 0);
}

}  // namespace ktr::test
