// Who hears of what was written, in this process and in others.
#include "server/store/Changes.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <condition_variable>
#include <limits>
#include <mutex>
#include <thread>

#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Change;
using server::Grant;
using server::Precision;
using server::Store;

namespace {

/// Collects what is told, for those who wait for it.
class Hearer {
  public:
    explicit Hearer(Store& store) : listening_(store.listen([this](const Change& change) { hear(change); })) {}

    /// Whether it was told of that person, or of everything, within a while; forgets what was told before.
    bool hearsOf(std::int64_t person, std::chrono::milliseconds patience = std::chrono::seconds(20)) {
        std::unique_lock<std::mutex> lock(mutex_);
        const bool heard = more_.wait_for(lock, patience, [&] { return heard_.concerns(person); });
        heard_ = {};
        return heard;
    }
    Change heard() {
        const std::lock_guard<std::mutex> lock(mutex_);
        return std::exchange(heard_, {});
    }
    void end() { listening_.reset(); }

  private:
    void hear(const Change& change) {
        const std::lock_guard<std::mutex> lock(mutex_);
        heard_.add(change);
        more_.notify_all();
    }

    std::mutex mutex_;
    std::condition_variable more_;
    Change heard_;
    std::shared_ptr<void> listening_;
};

}  // namespace

TEST(ChangeTest, Lines_SayItAgain) {
    const Change all{false, {1, 22, std::numeric_limits<std::int64_t>::max()}};
    for (const std::size_t limit : {64, 7000}) {
        Change read;
        for (const std::string& line : all.lines("me", limit)) {
            EXPECT_LE(line.size(), limit);
            std::string sender;
            read.add(Change::ofLine(line, sender));
            EXPECT_EQ(sender, "me");
        }
        EXPECT_EQ(read, all);
    }
    std::string sender;
    EXPECT_EQ(Change::ofLine(Change{true, {1}}.lines("me", 64).front(), sender), (Change{true, {}}));
    EXPECT_TRUE(Change{}.lines("me", 64).empty());
}

TEST(ChangeTest, ManyPeople_TakeSeveralLines) {
    Change all;
    for (std::int64_t person = 0; person < 2000; ++person) {
        all.people.insert(std::numeric_limits<std::int64_t>::max() - person);
    }
    const auto lines = all.lines("me", 7000);
    EXPECT_EQ(lines.size(), 6U);
    EXPECT_TRUE(std::all_of(lines.begin(), lines.end(), [](const auto& line) { return line.size() <= 7000; }));
}

TEST(ChangeTest, UnreadableLine_IsEverything) {
    for (const char* line : {"", "me", "me x", "me 1 2x", "me 99999999999999999999", "me  1"}) {
        std::string sender;
        EXPECT_EQ(Change::ofLine(line, sender), (Change{true, {}})) << line;
    }
}

class StoreChanges : public StoreContract {
  protected:
    /// Whom a call concerns: what is told until it returns.
    template <class Call>
    std::set<std::int64_t> toldBy(Call call) {
        if (!hearer_) {
            hearer_ = std::make_unique<Hearer>(*store_);
            settle(*hearer_);
        }
        EXPECT_TRUE(call());
        const Change heard = hearer_->heard();
        EXPECT_FALSE(heard.everything);
        return heard.people;
    }
    /// Listening begins with "everything" where others announce: one waits for that first.
    void settle(Hearer& hearer) {
        if (GetParam()) {
            ASSERT_TRUE(hearer.hearsOf(0));
        }
    }
    std::unique_ptr<Store> another() {
        std::string complaint;
        return Store::open(address_, false, complaint);
    }
    void TearDown() override { hearer_.reset(); }

    std::unique_ptr<Hearer> hearer_;
};
INSTANTIATE_TEST_SUITE_P(Sqlite, StoreChanges, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreChanges, ::testing::Values(true));

TEST_P(StoreChanges, WhatDecidesWhatIsSeen_IsToldBeforeTheWriterHears) {
    using People = std::set<std::int64_t>;
    EXPECT_EQ(toldBy([&] { return keep({at(kNow)}); }), People{ann_});
    EXPECT_EQ(toldBy([&] {
                  return store_->grant(ann_, mara_, {Precision::Town, kNow, std::nullopt});
              }),
              (People{ann_, mara_}));
    EXPECT_EQ(toldBy([&] { return store_->revokeGrant(ann_, mara_); }), (People{ann_, mara_}));
    EXPECT_EQ(toldBy([&] { return store_->setPlace(ann_, {0, "work", "", 50.0, 8.0, 200.0, true}); }), People{ann_});
    const server::NamedPlace place = store_->placesOf(ann_).front();
    EXPECT_EQ(toldBy([&] { return store_->changePlace(ann_, place); }), People{ann_});
    EXPECT_EQ(toldBy([&] { return finished([&](auto done) { store_->keepPlaces(ann_, {place}, done); }); }),
              People{ann_});
    EXPECT_EQ(toldBy([&] { return store_->setHidden(ann_, true, kNow); }), People{ann_});
    EXPECT_EQ(toldBy([&] { return finished([&](auto done) { store_->hide(ann_, kNow, done); }); }), People{ann_});
    EXPECT_EQ(toldBy([&] { return store_->setHidden(ann_, false, kNow); }), People{ann_});
    EXPECT_EQ(toldBy([&] { return store_->setRetention(ann_, {3600, 3600}, kNow); }), People{ann_});
    EXPECT_EQ(toldBy([&] { return store_->revokeDevice(ann_, phone_, kNow); }), People{ann_});
}

TEST_P(StoreChanges, GrantThatEndsOnArrival_NamesItsViewer) {
    ASSERT_TRUE(store_->setPlace(ann_, {0, "home", "", 50.2, -3.1, 200.0, true}));
    Grant grant{Precision::Exact, kNow - 10, std::nullopt};
    grant.arrival = store_->placesOf(ann_).front().id;
    ASSERT_TRUE(store_->grant(ann_, mara_, grant));
    EXPECT_EQ(toldBy([&] { return keep({at(kNow)}); }), (std::set<std::int64_t>{ann_, mara_}));
}

TEST_P(StoreChanges, WhatNobodySees_IsNotTold) {
    EXPECT_EQ(toldBy([&] {
                  return finished([&](auto done) { store_->noteLooks(otto_, {ann_}, true, kNow, done); }) &&
                         finished([&](auto done) { store_->askToShare(phone_, done); }) &&
                         finished([&](auto done) { store_->deleteOld(kNow, done); });
              }),
              std::set<std::int64_t>{});
}

TEST_P(StoreChanges, WhatWasRefused_IsNotTold) {
    Hearer hearer(*store_);
    settle(hearer);
    const server::NamedPlace impossible{0, std::string("\xff", 1), "", 50.0, 8.0, 200.0, true};
    EXPECT_FALSE(store_->setPlace(ann_, impossible));
    EXPECT_EQ(hearer.heard(), Change{});
}

TEST_P(StoreChanges, ForgottenPerson_IsEverything) {
    Hearer hearer(*store_);
    settle(hearer);
    ASSERT_TRUE(store_->forget(mara_, kNow));
    EXPECT_TRUE(hearer.heard().everything);
}

TEST_P(StoreChanges, AnotherProcess_IsHeard) {
    const auto other = another();
    ASSERT_TRUE(other);
    Hearer hearer(*store_);
    settle(hearer);
    ASSERT_TRUE(other->setHidden(ann_, true, kNow));
    EXPECT_TRUE(hearer.hearsOf(ann_));
    ASSERT_TRUE(other->revokeGrant(ann_, otto_));
    EXPECT_TRUE(hearer.hearsOf(otto_));
    ASSERT_TRUE(other->setHidden(ann_, false, kNow));
    EXPECT_TRUE(hearer.hearsOf(ann_));
    ASSERT_TRUE(finished([&](auto done) { other->keep(phone_, ann_, {at(kNow + 1)}, kNow + 1, done); }));
    EXPECT_TRUE(hearer.hearsOf(ann_));
}

TEST_P(StoreChanges, OwnWrites_AreToldOnce) {
    std::atomic<int> told = 0;
    Hearer all(*store_);
    settle(all);
    const auto listening = store_->listen([&](const Change& change) { told += change.concerns(ann_) ? 1 : 0; });
    ASSERT_TRUE(keep({at(kNow)}));
    ASSERT_TRUE(store_->setHidden(ann_, true, kNow));
    std::this_thread::sleep_for(2 * Store::kLookAfter);  // what would come from outside has come
    EXPECT_EQ(told, 2);
}

TEST_P(StoreChanges, EndedListening_IsNotToldAnyMore) {
    Hearer hearer(*store_);
    settle(hearer);
    hearer.end();
    ASSERT_TRUE(keep({at(kNow)}));
    EXPECT_EQ(hearer.heard(), Change{});
}

TEST_P(StoreChanges, ServerThatStartsAgain_IsEverything) {
    if (!GetParam()) {
        GTEST_SKIP() << "a file has no server";
    }
    Hearer hearer(*store_);
    settle(hearer);
    PrivatePostgres::shared()->restart();
    EXPECT_TRUE(hearer.hearsOf(0));  // when the connection was lost
    EXPECT_TRUE(hearer.hearsOf(0));  // and when it was made again
    const auto other = another();
    ASSERT_TRUE(other);
    ASSERT_TRUE(other->setHidden(ann_, true, kNow));
    EXPECT_TRUE(hearer.hearsOf(ann_));
}

}  // namespace ktr::test
