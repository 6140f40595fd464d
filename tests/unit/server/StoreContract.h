#pragma once

#include <gtest/gtest.h>

#include <future>
#include <memory>
#include <string>

#include "server/store/Store.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/unit/server/PrivatePostgres.h"

namespace ktr::test {

/// What every store does, on SQLite and on PostgreSQL alike. A test that begins with a fresh store of three people: ann
/// with a phone ("ann's"), whom otto sees exactly, and mara. Tests of a theme derive from it:
///
///     class StorePlaces : public StoreContract {};
///     INSTANTIATE_TEST_SUITE_P(Sqlite, StorePlaces, ::testing::Values(false));
///     INSTANTIATE_TEST_SUITE_P(Postgres, StorePlaces, ::testing::Values(true));
class StoreContract : public ::testing::TestWithParam<bool> {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    void SetUp() override {
        if (!GetParam()) {
            address_ = {(folder_.path() / "data").string()};
        } else if (PrivatePostgres* server = PrivatePostgres::shared(); server == nullptr) {
            GTEST_SKIP() << "needs a PostgreSQL server: KTR_LONG_TESTS=1 starts one";
        } else {
            ASSERT_EQ(server->complaint(), "");
            address_ = {server->newStore()};
        }
        open();
        for (const char* name : {"ann", "otto", "mara"}) {
            ASSERT_TRUE(store_->addPerson(name, {std::string(name) + "@x.example"}, kNow));
        }
        ann_ = store_->personNamed("ann")->id;
        otto_ = store_->personNamed("otto")->id;
        mara_ = store_->personNamed("mara")->id;
        ASSERT_TRUE(store_->addDevice(ann_, server::DeviceKind::Phone, "ann's", "", kNow));
        bool failed = false;
        phone_ = store_->deviceOf("ann's", failed)->id;
        ASSERT_TRUE(store_->grant(ann_, otto_, {server::Precision::Exact, kNow - 1000, std::nullopt}));
    }
    /// Also: opens it again.
    void open() {
        std::string complaint;
        store_.reset();
        store_ = server::Store::open(address_, true, complaint);
        ASSERT_TRUE(store_) << complaint;
    }
    bool keep(std::vector<server::Fix> fixes, std::int64_t now = kNow) {
        return finished([&](auto done) { store_->keep(phone_, ann_, std::move(fixes), now, done); });
    }
    /// Whether what calls `done` later was written.
    template <class Call>
    static bool finished(Call call) {
        std::promise<bool> written;
        call([&](bool good) { written.set_value(good); });
        return written.get_future().get();
    }
    static server::Fix at(std::int64_t time, double latitude = 50.2) {
        return {time, kNow, latitude, -3.1, std::nullopt};
    }
    std::vector<server::Fix> seenByOtto() { return store_->sharing(otto_, ann_)->fixes; }

    TemporaryFolder folder_;
    server::StoreAddress address_;
    std::unique_ptr<server::Store> store_;
    std::int64_t ann_ = 0;
    std::int64_t otto_ = 0;
    std::int64_t mara_ = 0;
    std::int64_t phone_ = 0;
};

}  // namespace ktr::test
