#include <algorithm>

#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::AskOutcome;
using server::Precision;
using server::Store;

class StoreAsks : public StoreContract {
  protected:
    AskOutcome ask(std::int64_t asker, const std::vector<std::string>& handles, std::int64_t now = kNow) {
        return store_->askToSee(asker, handles, now);
    }
    /// Their names.
    std::vector<std::string> askers(std::int64_t person, std::int64_t now = kNow) {
        const auto asked = store_->askersOf(person, now);
        EXPECT_TRUE(asked);
        std::vector<std::string> names;
        for (const auto& one : asked.value_or(std::vector<server::AskedBy>())) {
            names.push_back(one.name);
        }
        return names;
    }
    using Names = std::vector<std::string>;
};

TEST_P(StoreAsks, WhoeverIsAsked_HearsOfItByAnyOfTheirHandles_AndNobodyElseDoes) {
    EXPECT_EQ(ask(mara_, {"ANN@x.example", "nobody@x.example"}), AskOutcome::Asked);
    EXPECT_EQ(askers(ann_), Names{"mara"});
    EXPECT_EQ(askers(otto_), Names());
    EXPECT_EQ(askers(mara_), Names());
    const auto asked = store_->askersOf(ann_, kNow);
    EXPECT_EQ(asked->front().asker, mara_);
    EXPECT_EQ(asked->front().handle, "mara@x.example");
    EXPECT_EQ(asked->front().time, kNow);
}

TEST_P(StoreAsks, NotNow_IsNotUndoneOnTheSameDay) {
    ASSERT_EQ(ask(mara_, {"ann@x.example"}), AskOutcome::Asked);
    ASSERT_TRUE(store_->endAsk(ann_, mara_));
    EXPECT_EQ(askers(ann_), Names());
    EXPECT_EQ(ask(mara_, {"ann@x.example"}, kNow + Store::kAskAgainAfter - 1), AskOutcome::Asked) << "answered alike";
    EXPECT_EQ(askers(ann_, kNow + Store::kAskAgainAfter - 1), Names());
    EXPECT_EQ(ask(mara_, {"ann@x.example"}, kNow + Store::kAskAgainAfter), AskOutcome::Asked);
    EXPECT_EQ(askers(ann_, kNow + Store::kAskAgainAfter), Names{"mara"});
    ASSERT_TRUE(store_->endAsk(otto_, mara_));
    EXPECT_EQ(askers(ann_, kNow + Store::kAskAgainAfter), Names{"mara"}) << "it is not otto's to answer";
}

TEST_P(StoreAsks, WhoSeesAlready_DoesNotAsk_UntilThatEnds) {
    ASSERT_EQ(ask(otto_, {"ann@x.example"}), AskOutcome::Asked);
    EXPECT_EQ(askers(ann_), Names());
    ASSERT_TRUE(store_->revokeGrant(ann_, otto_));
    EXPECT_EQ(askers(ann_), Names{"otto"});
    ASSERT_TRUE(store_->grant(ann_, otto_, {Precision::Town, kNow, kNow + 60}));
    EXPECT_EQ(askers(ann_), Names());
    EXPECT_EQ(askers(ann_, kNow + 60), Names{"otto"});
}

TEST_P(StoreAsks, Oneself_IsNotAsked) {
    ASSERT_EQ(ask(ann_, {"ann@x.example"}), AskOutcome::Asked);
    EXPECT_EQ(askers(ann_), Names());
}

TEST_P(StoreAsks, SoManyADay_WhetherAnybodyIsThereOrNot) {
    std::vector<std::string> some;
    for (int i = 0; i < 50; ++i) {
        some.push_back("n" + std::to_string(i) + "@x.example");
    }
    EXPECT_EQ(ask(mara_, some), AskOutcome::Asked);
    std::vector<std::string> more = some;
    std::for_each(more.begin(), more.end(), [](std::string& handle) { handle += ".more"; });
    EXPECT_EQ(ask(mara_, more), AskOutcome::Asked);
    EXPECT_EQ(ask(mara_, {"ann@x.example"}), AskOutcome::TooMany);
    EXPECT_EQ(ask(mara_, {"nobody@x.example"}), AskOutcome::TooMany);
    EXPECT_EQ(askers(ann_), Names());
    EXPECT_EQ(ask(mara_, {"ann@x.example"}, kNow + Store::kAskAgainAfter), AskOutcome::Asked);
}

TEST_P(StoreAsks, WhatIsOld_IsHeardNoMore_AndGoesWithItsPeople) {
    ASSERT_EQ(ask(mara_, {"ann@x.example"}), AskOutcome::Asked);
    EXPECT_EQ(askers(ann_, kNow + Store::kAsksKept), Names());
    ASSERT_EQ(ask(otto_, {"mara@x.example"}), AskOutcome::Asked);
    ASSERT_TRUE(store_->forget(mara_, kNow));
    EXPECT_EQ(askers(ann_), Names());
    // Whoever has the handle next was not asked.
    ASSERT_TRUE(store_->addPerson("another", {"mara@x.example"}, kNow));
    EXPECT_EQ(askers(store_->personNamed("another")->id), Names());
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreAsks, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreAsks, ::testing::Values(true));

}  // namespace ktr::test
