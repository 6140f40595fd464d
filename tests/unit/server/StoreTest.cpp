#include "server/store/Store.h"

#include <gtest/gtest.h>
#include <sqlite3.h>
#include <sys/stat.h>

#include <atomic>
#include <fstream>
#include <future>
#include <iterator>
#include <thread>

#include "server/store/Secret.h"
#include "tests/support/TemporaryFolder.h"

namespace ktr::test {

using server::DeviceKind;
using server::Fix;
using server::Grant;
using server::Precision;
using server::Secret;
using server::Sharing;
using server::Store;

class StoreTest : public ::testing::Test {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    void SetUp() override {
        open();
        for (const char* name : {"ann", "otto", "mara"}) {
            ASSERT_TRUE(store_->addPerson(name, {std::string(name) + "@x.example"}, kNow));
        }
        ann_ = store_->personNamed("ann")->id;
        otto_ = store_->personNamed("otto")->id;
        ASSERT_TRUE(store_->addDevice(ann_, DeviceKind::Phone, "ann's", "", kNow));
        ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, kNow - 1000, std::nullopt}));
    }
    void open() {
        std::string complaint;
        store_.reset();
        store_ = Store::open(folder(), true, complaint);
        ASSERT_TRUE(store_) << complaint;
    }
    std::string folder() const { return (folder_.path() / "data").string(); }
    bool keep(std::vector<Fix> fixes, std::int64_t now = kNow) {
        std::promise<bool> done;
        store_->keep(1, ann_, std::move(fixes), now, [&](bool good) { done.set_value(good); });
        return done.get_future().get();
    }
    static Fix at(std::int64_t time, double latitude = 50.2) { return {time, kNow, latitude, -3.1, std::nullopt}; }
    std::vector<Fix> seenByOtto() { return store_->sharing(otto_, ann_)->fixes; }

    TemporaryFolder folder_;
    std::unique_ptr<Store> store_;
    std::int64_t ann_ = 0;
    std::int64_t otto_ = 0;
};

TEST_F(StoreTest, Fixes_ComeBackInTheOrderOfTheirTimes_EachOnce_AfterAnotherStart) {
    EXPECT_TRUE(keep({at(kNow - 10), at(kNow - 30)}));
    EXPECT_TRUE(keep({at(kNow - 20), at(kNow - 10, 51.0)}));
    const std::vector<Fix> expected = {at(kNow - 30), at(kNow - 20), at(kNow - 10)};
    EXPECT_EQ(seenByOtto(), expected);
    open();
    EXPECT_EQ(seenByOtto(), expected);
}

TEST_F(StoreTest, HiddenPerson_IsNotWrittenDown_AndNotSeenLater) {
    EXPECT_TRUE(keep({at(kNow - 10)}));
    std::promise<bool> hidden;
    store_->hide(ann_, kNow, [&](bool good) { hidden.set_value(good); });
    ASSERT_TRUE(hidden.get_future().get());
    EXPECT_TRUE(store_->sharing(otto_, ann_)->hidden);
    EXPECT_TRUE(keep({at(kNow + 5)}, kNow + 5));
    EXPECT_EQ(store_->lastHeard(ann_), kNow) << "not even that the phone lives";
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow + 100));
    EXPECT_TRUE(keep({at(kNow + 50), at(kNow + 110)}, kNow + 110));
    EXPECT_EQ(store_->sharing(otto_, ann_)->shownSince, kNow + 100);
    EXPECT_EQ(seenByOtto(), std::vector<Fix>{at(kNow + 110)}) << "what a phone kept while hidden comes too late";
    ASSERT_TRUE(store_->setHidden(ann_, false, kNow + 500));
    EXPECT_EQ(store_->sharing(otto_, ann_)->shownSince, kNow + 100) << "showing twice changes nothing";
}

TEST_F(StoreTest, Grants_AreReplacedAndRevoked) {
    const auto mara = store_->personNamed("mara")->id;
    EXPECT_EQ(store_->sharing(mara, ann_)->grant, std::nullopt);
    ASSERT_TRUE(store_->grant(ann_, mara, {Precision::Town, kNow, kNow + 60}));
    EXPECT_EQ(store_->sharing(mara, ann_)->grant, (Grant{Precision::Town, kNow, kNow + 60}));
    EXPECT_EQ(store_->sharing(ann_, mara)->grant, std::nullopt) << "one way only";
    EXPECT_EQ(store_->grantsOf(ann_).size(), 2U);
    EXPECT_EQ(store_->friendsOf(mara).size(), 1U);
    EXPECT_TRUE(store_->revokeGrant(ann_, mara));
    EXPECT_FALSE(store_->revokeGrant(ann_, mara));
    EXPECT_EQ(store_->sharing(mara, ann_)->grant, std::nullopt);
    EXPECT_TRUE(store_->friendsOf(mara).empty());
}

TEST_F(StoreTest, Secrets_AreKeptAsHashes_AndEndWhenRevoked) {
    bool failed = false;
    const auto device = store_->deviceOf("ann's", failed);
    ASSERT_TRUE(device);
    EXPECT_EQ(device->name, "ann");
    EXPECT_EQ(store_->deviceOf("otto's", failed), std::nullopt);
    EXPECT_EQ(store_->revokeDevices(ann_, kNow), 1);
    EXPECT_EQ(store_->deviceOf("ann's", failed), std::nullopt);
    EXPECT_FALSE(failed);
    const std::string secret = Secret::make().value_or("");
    ASSERT_TRUE(store_->addDevice(otto_, DeviceKind::Reader, secret, "", kNow));
    store_.reset();
    for (const char* name : {"service.db", "service.db-wal"}) {
        std::ifstream file(folder() + "/" + name, std::ios::binary);
        const std::string bytes{std::istreambuf_iterator<char>(file), {}};
        EXPECT_EQ(bytes.find(secret), std::string::npos) << name;
    }
}

TEST_F(StoreTest, Secret_Has128RandomBits) {
    const auto one = Secret::make();
    ASSERT_TRUE(one);
    EXPECT_EQ(one->size(), 26U);
    EXPECT_NE(one, Secret::make());
}

TEST_F(StoreTest, Handles_AreFoundInAnyWriting_AndBelongToOnePerson) {
    ASSERT_TRUE(store_->addPerson("zoe", {"Zoe@X.example", "+44 1632 960-001"}, kNow));
    const auto zoe = store_->personNamed("zoe")->id;
    EXPECT_EQ(store_->personOf("zoe@x.EXAMPLE"), zoe);
    EXPECT_EQ(store_->personOf("+441632960001"), zoe);
    EXPECT_EQ(store_->personOf("nobody@x.example"), std::nullopt);
    EXPECT_EQ(store_->person(zoe)->handles, (std::vector<std::string>{"Zoe@X.example", "+44 1632 960-001"}));
    EXPECT_FALSE(store_->addPerson("zoe", {}, kNow)) << "a name is one person's";
    EXPECT_FALSE(store_->addPerson("other", {"ZOE@x.example"}, kNow)) << "a handle as well";
    EXPECT_EQ(store_->personNamed("other"), std::nullopt) << "nothing is left of it";
}

TEST_F(StoreTest, OldFixes_AreDeletedInTurn) {
    ASSERT_TRUE(keep({at(kNow - 10), at(kNow - 3 * 86400)}));
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, 0, std::nullopt}));
    EXPECT_EQ(seenByOtto().size(), 2U);
    for (int i = 0; i < 3; ++i) {
        std::promise<bool> done;
        store_->deleteOld(kNow, [&](bool good) { done.set_value(good); });
        EXPECT_TRUE(done.get_future().get());
    }
    EXPECT_EQ(seenByOtto(), std::vector<Fix>{at(kNow - 10)});
}

TEST_F(StoreTest, Present_NeverGoesBack_NotByAnotherStart) {
    EXPECT_EQ(store_->present(kNow + 50), kNow + 50);
    EXPECT_EQ(store_->present(kNow), kNow + 50);
    EXPECT_TRUE(keep({}));
    open();
    EXPECT_EQ(store_->present(kNow), kNow + 50);
    EXPECT_EQ(store_->sharing(otto_, ann_)->latest, kNow + 50);
}

TEST_F(StoreTest, ManyPosters_AreAllWritten) {
    std::vector<std::thread> threads;
    std::atomic<int> written = 0;
    for (int thread = 0; thread < 8; ++thread) {
        threads.emplace_back([&, thread] {
            for (int i = 0; i < 50; ++i) {
                written += keep({at(kNow - 1000 + thread * 50 + i)}) ? 1 : 0;
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(written, 400);
    EXPECT_EQ(seenByOtto().size(), 400U);
}

TEST_F(StoreTest, WhatWaits_IsWrittenBeforeTheEnd) {
    std::atomic<int> written = 0;
    for (int i = 0; i < 200; ++i) {
        store_->keep(1, ann_, {at(kNow - i)}, kNow, [&](bool good) { written += good ? 1 : 0; });
    }
    open();
    EXPECT_EQ(written, 200);
    EXPECT_EQ(seenByOtto().size(), 200U);
}

TEST_F(StoreTest, NewerStore_AndForeignFiles_AreRefusedWithASentence) {
    const std::string file = folder() + "/service.db";
    struct stat facts {};
    ASSERT_EQ(::stat(file.c_str(), &facts), 0);
    EXPECT_EQ(facts.st_mode & 0777U, 0600U);
    store_.reset();
    sqlite3* handle = nullptr;
    ASSERT_EQ(sqlite3_open(file.c_str(), &handle), SQLITE_OK);
    sqlite3_exec(handle, "PRAGMA user_version=2", nullptr, nullptr, nullptr);
    sqlite3_close(handle);
    std::string complaint;
    EXPECT_EQ(Store::open(folder(), true, complaint), nullptr);
    EXPECT_NE(complaint.find("newer program"), std::string::npos) << complaint;

    std::ofstream(file, std::ios::trunc) << std::string(5000, 'x');
    complaint.clear();
    EXPECT_EQ(Store::open(folder(), true, complaint), nullptr);
    EXPECT_NE(complaint, "");
    complaint.clear();
    EXPECT_EQ(Store::open("/not/there", false, complaint), nullptr);
    EXPECT_NE(complaint, "");
}

TEST_F(StoreTest, WholeFile_IsFoundWhole) {
    EXPECT_EQ(store_->check(), "");
}

}  // namespace ktr::test
