// What was acknowledged is kept: with the power cut, on a full disk, on a disk that fails.
#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <mutex>
#include <set>
#include <thread>

#include "tests/unit/server/FaultyDisk.h"
#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Fix;
using server::Precision;
using server::Store;

class StoreDurabilityTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;
    static constexpr int kPeople = 6;

    void SetUp() override {
        std::string complaint;
        store_ = Store::open({path("data")}, true, complaint);
        ASSERT_TRUE(store_) << complaint;
        ASSERT_TRUE(store_->addPerson("viewer", {}, kNow));
        const auto viewer = store_->personNamed("viewer")->id;
        for (int i = 0; i < kPeople; ++i) {
            const std::string name = "person " + std::to_string(i);
            ASSERT_TRUE(store_->addPerson(name, {}, kNow));
            people_.push_back(store_->personNamed(name)->id);
            ASSERT_TRUE(store_->grant(people_.back(), viewer, {Precision::Exact, 1, std::nullopt}));
        }
    }
    std::string path(const std::string& name) const { return (folder_.path() / name).string(); }
    bool keep(int person, std::int64_t time) {
        std::promise<bool> written;
        store_->keep(0, people_[static_cast<std::size_t>(person)], {{time, time, 50.0, 8.0, std::nullopt}}, kNow,
                     [&](bool good) { written.set_value(good); });
        return written.get_future().get();
    }
    /// Posts as that person until the end, and writes down what was acknowledged.
    void post(int person) {
        for (std::int64_t time = kNow; !ending_; ++time) {
            if (keep(person, time)) {
                const std::lock_guard<std::mutex> lock(mutex_);
                acknowledged_.emplace_back(person, time);
            }
        }
    }
    using Acknowledged = std::vector<std::pair<int, std::int64_t>>;
    Acknowledged acknowledged() {
        const std::lock_guard<std::mutex> lock(mutex_);
        return acknowledged_;
    }
    /// How many of these a store has not.
    std::size_t missing(Store& store, const Acknowledged& expected) const {
        const auto viewer = store.personNamed("viewer");
        std::vector<std::set<std::int64_t>> found(kPeople);
        for (int i = 0; viewer && i < kPeople; ++i) {
            const auto sharing = store.sharing(viewer->id, people_[static_cast<std::size_t>(i)]);
            for (const Fix& fix : sharing ? sharing->fixes : std::vector<Fix>()) {
                found[static_cast<std::size_t>(i)].insert(fix.time);
            }
        }
        std::size_t lost = 0;
        for (const auto& [person, time] : expected) {
            lost += found[static_cast<std::size_t>(person)].count(time) == 0 ? 1U : 0U;
        }
        return lost;
    }

    TemporaryFolder folder_;
    FaultyDisk disk_;
    std::unique_ptr<Store> store_;
    std::vector<std::int64_t> people_;
    std::atomic<bool> ending_ = false;

  private:
    std::mutex mutex_;
    Acknowledged acknowledged_;
};

TEST_F(StoreDurabilityTest, PowerCutAtAnyMoment_LosesNothingThatWasAcknowledged) {
    const int cuts = std::getenv("KTR_LONG_TESTS") != nullptr ? 200 : 20;
    std::mt19937 chance(20261122);
    std::vector<std::thread> posters;
    for (int i = 0; i < kPeople; ++i) {
        posters.emplace_back([this, i] { post(i); });
    }
    std::vector<Acknowledged> before;
    for (int cut = 0; cut < cuts; ++cut) {
        const std::size_t known = acknowledged().size();
        while (acknowledged().size() < known + 20 + chance() % 100) {
            std::this_thread::yield();
        }
        before.push_back(acknowledged());
        disk_.cutPower(folder_.path() / ("cut" + std::to_string(cut)), chance);
    }
    ending_ = true;
    for (std::thread& poster : posters) {
        poster.join();
    }
    EXPECT_GT(disk_.syncs(), cuts);
    for (int cut = 0; cut < cuts; ++cut) {
        std::string complaint;
        const auto after = Store::open({path("cut" + std::to_string(cut))}, false, complaint);
        ASSERT_TRUE(after) << cut << ": " << complaint;
        EXPECT_EQ(missing(*after, before[static_cast<std::size_t>(cut)]), 0U) << cut;
        EXPECT_EQ(after->check(), "") << cut;
    }
}

TEST_F(StoreDurabilityTest, FullDisk_IsSaid_AndNothingIsMissingAfterwards) {
    Acknowledged kept;
    Acknowledged refused;
    std::int64_t time = kNow;
    for (int round = 0; round < 40; ++round) {
        disk_.setRoom(round * 1500);
        for (int i = 0; i < 6; ++i, ++time) {
            (keep(i, time) ? kept : refused).emplace_back(i, time);
        }
        disk_.setRoom(-1);
        EXPECT_TRUE(keep(0, time)) << "mended in round " << round;
        kept.emplace_back(0, time++);
    }
    EXPECT_GT(refused.size(), 20U);
    EXPECT_GT(kept.size(), 60U);
    EXPECT_EQ(missing(*store_, kept), 0U);
    EXPECT_EQ(missing(*store_, refused), refused.size()) << "what was refused is not kept by halves";
    // Phones send again what was refused.
    for (const auto& [person, when] : refused) {
        EXPECT_TRUE(keep(person, when));
    }
    EXPECT_EQ(missing(*store_, refused), 0U);
    EXPECT_EQ(store_->check(), "");
}

TEST_F(StoreDurabilityTest, DiskThatTakesNothing_IsSaid) {
    EXPECT_TRUE(keep(0, kNow));
    disk_.setBroken(true);
    EXPECT_FALSE(keep(0, kNow + 1)) << "not on the disk: not acknowledged";
    EXPECT_FALSE(store_->addPerson("somebody", {}, kNow));
    disk_.setBroken(false);
    EXPECT_TRUE(keep(0, kNow + 2));
    EXPECT_EQ(missing(*store_, {{0, kNow}, {0, kNow + 2}}), 0U);
    EXPECT_EQ(store_->personNamed("somebody"), std::nullopt);
    std::mt19937 chance(1);
    disk_.cutPower(folder_.path() / "cut", chance);
    std::string complaint;
    const auto after = Store::open({path("cut")}, false, complaint);
    ASSERT_TRUE(after) << complaint;
    EXPECT_EQ(missing(*after, {{0, kNow}, {0, kNow + 2}}), 0U);
}

}  // namespace ktr::test
