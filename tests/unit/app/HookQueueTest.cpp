#include "app/HookQueue.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <memory>
#include <optional>
#include <vector>

#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using app::Crossing;
using app::HookQueue;

class HookQueueTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    void start() {
        queue_ = std::make_unique<HookQueue>(
            HookQueue::Setup{file_,
                             [this](const Crossing& crossing, std::function<void()> done) {
                                 posted_.push_back(crossing.number);
                                 done_ = std::move(done);
                             },
                             [this](const std::string& line) { told_.push_back(line); }, [this] { return now_; }});
        queue_->start();
    }
    static Crossing crossing(std::int64_t number, std::int64_t time = kNow) {
        return {number, "Ann", "ann@x.example", "Home \"on\" the quay", true, time};
    }
    void answer() {
        const auto done = std::exchange(done_, nullptr);
        done();
    }

    TemporaryFolder folder_;
    const std::filesystem::path file_ = folder_.path() / "watch-hook";
    std::int64_t now_ = kNow;
    std::vector<std::int64_t> posted_;
    std::vector<std::string> told_;
    std::function<void()> done_;
    std::unique_ptr<HookQueue> queue_;
};

TEST_F(HookQueueTest, OneAfterTheOther_InOrder_AndAddingWaitsForNobody) {
    start();
    for (int number = 1; number <= 3; ++number) {
        queue_->add(crossing(number));
    }
    EXPECT_EQ(posted_, (std::vector<std::int64_t>{1}));
    EXPECT_EQ(queue_->size(), 3U);
    answer();
    answer();
    EXPECT_EQ(posted_, (std::vector<std::int64_t>{1, 2, 3}));
    answer();
    EXPECT_EQ(queue_->size(), 0U);
    EXPECT_EQ(told_, std::vector<std::string>());
}

TEST_F(HookQueueTest, WhatWaits_IsPostedByTheNextProcess_AndOnce) {
    start();
    queue_->add(crossing(1));
    queue_->add(crossing(2));
    answer();
    struct stat facts {};
    ASSERT_EQ(::stat(file_.c_str(), &facts), 0);
    EXPECT_EQ(facts.st_mode & 0777, 0600U) << "it says who was where";
    queue_.reset();
    posted_.clear();
    start();
    EXPECT_EQ(posted_, (std::vector<std::int64_t>{2}));
    // What was handed on twice has the same number.
    queue_->add(crossing(2));
    queue_->add(crossing(1));
    EXPECT_EQ(queue_->size(), 1U);
    queue_->add(crossing(3));
    answer();
    EXPECT_EQ(posted_, (std::vector<std::int64_t>{2, 3}));
}

TEST_F(HookQueueTest, WhatWasKept_IsWhatIsPosted) {
    const Crossing whole = crossing(7);
    EXPECT_EQ(Crossing::read(whole.json()), whole);
    Crossing bare = whole;
    bare.place = bare.handle = "";
    bare.arrives = false;
    EXPECT_EQ(Crossing::read(bare.json()), bare);
}

TEST_F(HookQueueTest, WhatIsTooOldOrTooMuch_GoesAndIsSaid) {
    start();
    queue_->add(crossing(1));
    now_ += HookQueue::kLasts;
    queue_->add(crossing(2));
    queue_->add(crossing(3, now_));
    answer();
    EXPECT_EQ(posted_, (std::vector<std::int64_t>{1, 3}));
    EXPECT_EQ(told_.size(), 1U);
    for (std::int64_t number = 4; number < 4 + static_cast<std::int64_t>(HookQueue::kMost); ++number) {
        queue_->add(crossing(number, now_));
    }
    EXPECT_EQ(queue_->size(), HookQueue::kMost);
    EXPECT_EQ(told_.size(), 2U);
    answer();
    EXPECT_EQ(posted_.back(), 5) << "the oldest that was not under way went";
}

TEST_F(HookQueueTest, FileThatIsNone_IsSaidAndWrittenAnew) {
    for (const char* text : {"no json", "{\"last\":\"x\"}", "{\"waiting\":[7]}", ""}) {
        folder_.write("watch-hook", text);
        ::chmod(file_.c_str(), 0600);
        told_.clear();
        posted_.clear();
        start();
        EXPECT_EQ(told_.size(), 1U) << text;
        queue_->add(crossing(1));
        EXPECT_EQ(posted_, (std::vector<std::int64_t>{1})) << text;
    }
}

TEST_F(HookQueueTest, DiskThatTakesNothing_IsSaid_AndThePostGoesOut) {
    start();
    std::filesystem::create_directory(file_);
    queue_->add(crossing(1));
    EXPECT_EQ(posted_, (std::vector<std::int64_t>{1}));
    EXPECT_EQ(told_.size(), 1U);
}

}  // namespace ktr::test
