#include "server/store/Store.h"

#include <gtest/gtest.h>

#include <atomic>
#include <future>
#include <thread>

#include "server/store/Secret.h"
#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::DeviceKind;
using server::Fix;
using server::Grant;
using server::Precision;
using server::Secret;
using server::Store;

class StoreBasics : public StoreContract {};

TEST_P(StoreBasics, Fixes_ComeBackInTheOrderOfTheirTimes_EachOnce_AfterAnotherStart) {
    EXPECT_TRUE(keep({at(kNow - 10), at(kNow - 30)}));
    EXPECT_TRUE(keep({at(kNow - 20), at(kNow - 10, 51.0)}));
    const std::vector<Fix> expected = {at(kNow - 30), at(kNow - 20), at(kNow - 10)};
    EXPECT_EQ(seenByOtto(), expected);
    open();
    EXPECT_EQ(seenByOtto(), expected);
}

TEST_P(StoreBasics, HiddenPerson_IsNotWrittenDown_AndNotSeenLater) {
    EXPECT_TRUE(keep({at(kNow - 10)}));
    ASSERT_TRUE(finished([&](auto done) { store_->hide(ann_, kNow, done); }));
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

TEST_P(StoreBasics, Grants_AreReplacedAndRevoked) {
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant, std::nullopt);
    ASSERT_TRUE(store_->grant(ann_, mara_, {Precision::Town, kNow, kNow + 60}));
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant, (Grant{Precision::Town, kNow, kNow + 60}));
    EXPECT_EQ(store_->sharing(ann_, mara_)->grant, std::nullopt) << "one way only";
    EXPECT_EQ(store_->grantsOf(ann_).size(), 2U);
    EXPECT_EQ(store_->friendsOf(mara_, kNow).size(), 1U);
    EXPECT_TRUE(store_->revokeGrant(ann_, mara_));
    EXPECT_FALSE(store_->revokeGrant(ann_, mara_));
    EXPECT_EQ(store_->sharing(mara_, ann_)->grant, std::nullopt);
    EXPECT_TRUE(store_->friendsOf(mara_, kNow).empty());
}

TEST_P(StoreBasics, Secrets_AreKeptAsHashes_AndEndWhenRevoked) {
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
    EXPECT_TRUE(store_->deviceOf(secret, failed));
    store_.reset();
    for (const char* name : {"service.db", "service.db-wal"}) {
        EXPECT_EQ(TemporaryFolder::read(address_.text + "/" + name).find(secret), std::string::npos) << name;
    }
}

TEST_P(StoreBasics, Handles_AreFoundInAnyWriting_AndBelongToOnePerson) {
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

TEST_P(StoreBasics, OldFixes_AreDeletedInTurn) {
    ASSERT_TRUE(keep({at(kNow - 10), at(kNow - 3 * 86400)}));
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Exact, 0, std::nullopt}));
    EXPECT_EQ(seenByOtto().size(), 2U);
    for (int i = 0; i < 3; ++i) {
        EXPECT_TRUE(finished([&](auto done) { store_->deleteOld(kNow, done); }));
    }
    EXPECT_EQ(seenByOtto(), std::vector<Fix>{at(kNow - 10)});
}

TEST_P(StoreBasics, Present_NeverGoesBack_NotByAnotherStart) {
    EXPECT_EQ(store_->present(kNow + 50), kNow + 50);
    EXPECT_EQ(store_->present(kNow), kNow + 50);
    EXPECT_TRUE(keep({}));
    open();
    EXPECT_EQ(store_->present(kNow), kNow + 50);
    EXPECT_EQ(store_->sharing(otto_, ann_)->latest, kNow + 50);
}

TEST_P(StoreBasics, ManyPosters_AreAllWritten) {
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

TEST_P(StoreBasics, WhatWaits_IsWrittenBeforeTheEnd) {
    std::atomic<int> written = 0;
    for (int i = 0; i < 200; ++i) {
        store_->keep(phone_, ann_, {at(kNow - i)}, kNow, [&](bool good) { written += good ? 1 : 0; });
    }
    open();
    EXPECT_EQ(written, 200);
    EXPECT_EQ(seenByOtto().size(), 200U);
}

TEST_P(StoreBasics, WholeFile_IsFoundWhole) {
    EXPECT_EQ(store_->check(), "");
}

TEST_P(StoreBasics, Finish_ReturnsWhenAllWhoWaitedHaveHeard) {
    std::atomic<int> heard = 0;
    for (int i = 0; i < 700; ++i) {
        store_->keep(phone_, ann_, {at(kNow - i)}, kNow, [&](bool good) { heard += good ? 1 : 0; });
    }
    store_->finish();
    EXPECT_EQ(heard, 700);
}

TEST_P(StoreBasics, WhatOneCannotWrite_RefusesNoneOfTheOthers) {
    // In one batch: the writing thread is busy with the first of them.
    std::promise<void> go;
    std::vector<std::promise<bool>> written(6);
    store_->keep(phone_, ann_, {}, kNow, [waiting = go.get_future().share()](bool) { waiting.wait(); });
    const auto later = [&](std::size_t i) { return [&, i](bool good) { written[i].set_value(good); }; };
    store_->keep(phone_, ann_, {at(kNow - 1)}, kNow, later(0));
    store_->noteLooks(otto_, {std::int64_t{77}}, true, kNow, later(1));  // nobody has this number
    store_->keep(phone_, ann_, {at(kNow - 2)}, kNow, later(2));
    store_->noteLooks(std::int64_t{78}, {ann_}, true, kNow, later(3));
    store_->hide(mara_, kNow, later(4));
    store_->noteCards(phone_, {{ann_, {"hash", kNow, 0}}}, later(5));
    go.set_value();
    const std::vector<bool> expected = {true, false, true, false, true, true};
    for (std::size_t i = 0; i < written.size(); ++i) {
        EXPECT_EQ(written[i].get_future().get(), expected[i]) << i;
    }
    EXPECT_EQ(seenByOtto().size(), 2U);
    EXPECT_TRUE(store_->person(mara_)->hidden);
    EXPECT_EQ(store_->cards(phone_, otto_).at(ann_).sent.hash, "hash");
}

TEST_P(StoreBasics, Texts_AreUtf8WithoutZeros_Everywhere) {
    using namespace std::string_literals;
    for (const std::string& text : {"a\0b"s, "\xff\xfe"s, "\xed\xa0\x80"s}) {
        EXPECT_FALSE(store_->addPerson(text, {}, kNow));
        EXPECT_EQ(store_->personNamed(text), std::nullopt);
        EXPECT_EQ(store_->personOf(text + "@x.example"), std::nullopt);
    }
    EXPECT_TRUE(store_->addPerson("Zo\xc3\xab", {}, kNow));
    EXPECT_TRUE(store_->personNamed("Zo\xc3\xab")) << "what failed before does not stay";
}

TEST_P(StoreBasics, Numbers_ComeBackAsTheyWere) {
    const Fix fix{kNow, kNow + 1, 1.0 / 3.0, -179.99999999999997, 1e-300};
    const Fix whole{kNow + 1, kNow + 1, -90.0, 180.0, 25.0};
    ASSERT_TRUE(keep({fix, whole}));
    EXPECT_EQ(seenByOtto(), (std::vector<Fix>{fix, whole}));
}

TEST_P(StoreBasics, Names_AreInTheOrderOfTheirBytes) {
    for (const char* name : {"Zoe", "anna-b", "anna a", "\xc3\x84nne"}) {
        ASSERT_TRUE(store_->addPerson(name, {}, kNow));
    }
    std::vector<std::string> names;
    for (const server::Person& person : store_->people()) {
        names.push_back(person.name);
    }
    EXPECT_EQ(names, (std::vector<std::string>{"Zoe", "ann", "anna a", "anna-b", "mara", "otto", "\xc3\x84nne"}));
}

TEST_P(StoreBasics, SecondProcess_SeesWhatTheFirstWrites_AndTheLatestTime) {
    std::string complaint;
    const auto other = Store::open(address_, false, complaint);
    ASSERT_TRUE(other) << complaint;
    store_->present(kNow + 900);
    ASSERT_TRUE(keep({at(kNow)}));
    EXPECT_EQ(other->sharing(otto_, ann_)->fixes.size(), 1U);
    EXPECT_EQ(other->sharing(otto_, ann_)->latest, kNow + 900) << "its own clock may be behind";
    ASSERT_TRUE(finished([&](auto done) { other->hide(ann_, kNow, done); }));
    EXPECT_TRUE(store_->sharing(otto_, ann_)->hidden);
    ASSERT_TRUE(keep({at(kNow + 1)}));
    EXPECT_EQ(other->revokeDevices(ann_, kNow), 1);
    bool failed = false;
    EXPECT_EQ(store_->deviceOf("ann's", failed), std::nullopt);
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreBasics, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreBasics, ::testing::Values(true));

}  // namespace ktr::test
