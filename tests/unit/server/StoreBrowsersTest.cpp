#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::Browser;
using server::SignIn;
using server::Store;

class StoreBrowsers : public StoreContract {
  protected:
    std::optional<Browser> browser(const char* session, std::int64_t now = kNow) {
        bool failed = false;
        auto found = store_->browserOf(session, now, failed);
        EXPECT_FALSE(failed);
        return found;
    }
};

TEST_P(StoreBrowsers, Link_SignsInOnce) {
    ASSERT_TRUE(store_->addSignIn(ann_, "link", kNow));
    EXPECT_EQ(store_->signIn("other", "session", kNow + 1), SignIn::Spent);
    EXPECT_EQ(store_->signIn("link", "session", kNow + 1), SignIn::Done);
    EXPECT_EQ(store_->signIn("link", "second", kNow + 2), SignIn::Spent);
    ASSERT_TRUE(browser("session"));
    EXPECT_EQ(browser("session")->person, ann_);
    EXPECT_EQ(browser("session")->made, kNow + 1);
    EXPECT_FALSE(browser("second"));
    EXPECT_FALSE(browser("link")) << "a link is no session";
}

TEST_P(StoreBrowsers, Link_MakesAReaderInstead_OnceAndOnlyThat) {
    ASSERT_TRUE(store_->addSignIn(ann_, "link", kNow));
    std::string person;
    EXPECT_EQ(store_->signProgramIn("other", "secret", kNow + 1, person), SignIn::Spent);
    EXPECT_EQ(store_->signProgramIn("link", "secret", kNow + 1, person), SignIn::Done);
    EXPECT_EQ(person, store_->person(ann_)->name);
    EXPECT_EQ(store_->signProgramIn("link", "second", kNow + 2, person), SignIn::Spent);
    EXPECT_EQ(store_->signIn("link", "session", kNow + 2), SignIn::Spent) << "nor a browser afterwards";
    bool failed = false;
    const auto device = store_->deviceOf("secret", failed);
    ASSERT_TRUE(device);
    EXPECT_EQ(device->person, ann_);
    EXPECT_EQ(device->kind, server::DeviceKind::Reader);
    EXPECT_FALSE(store_->deviceOf("second", failed));
    EXPECT_FALSE(store_->deviceOf("link", failed)) << "a link is no secret";
    ASSERT_TRUE(store_->addSignIn(ann_, "late", kNow));
    EXPECT_EQ(store_->signProgramIn("late", "third", kNow + Store::kSignInLasts + 2, person), SignIn::Spent);
    EXPECT_FALSE(store_->deviceOf("third", failed));
}

TEST_P(StoreBrowsers, Link_EndsAfterItsQuarterOfAnHour_WhateverTheClockSaysThen) {
    ASSERT_TRUE(store_->addSignIn(ann_, "link", kNow));
    EXPECT_EQ(store_->present(kNow + Store::kSignInLasts), kNow + Store::kSignInLasts);
    EXPECT_EQ(store_->signIn("link", "session", kNow + 5), SignIn::Spent) << "the clock was set back";
    ASSERT_TRUE(store_->addSignIn(ann_, "second", kNow));
    EXPECT_EQ(store_->signIn("second", "session", kNow + Store::kSignInLasts + 899), SignIn::Done);
}

TEST_P(StoreBrowsers, PhoneWithItsLink_IsThereAsAWhole_OrNotAtAll) {
    const std::int64_t phone = store_->addPhoneWithLink(mara_, "mara's", "link", kNow);
    bool failed = false;
    ASSERT_TRUE(store_->deviceOf("mara's", failed));
    EXPECT_EQ(store_->deviceOf("mara's", failed)->id, phone);
    // This link is there already.
    EXPECT_EQ(store_->addPhoneWithLink(mara_, "another", "link", kNow), 0);
    EXPECT_FALSE(store_->deviceOf("another", failed));
    EXPECT_EQ(store_->devicesOf(mara_).size(), 1U);
    EXPECT_EQ(store_->signIn("link", "session", kNow + 1), SignIn::Done);
}

TEST_P(StoreBrowsers, Browser_EndsAfterItsTime_AndWhenItIsEnded) {
    for (const char* name : {"first", "second"}) {
        ASSERT_TRUE(store_->addSignIn(ann_, name, kNow));
        ASSERT_EQ(store_->signIn(name, name, kNow), SignIn::Done);
    }
    ASSERT_EQ(store_->browsersOf(ann_, kNow).size(), 2U);
    EXPECT_TRUE(store_->browsersOf(otto_, kNow).empty());
    EXPECT_TRUE(store_->endBrowser(otto_, browser("first")->id));
    EXPECT_TRUE(browser("first")) << "it is not otto's to end";
    EXPECT_TRUE(store_->endBrowser(ann_, browser("first")->id));
    EXPECT_FALSE(browser("first"));
    EXPECT_TRUE(browser("second", kNow + Store::kBrowserLasts - 1));
    EXPECT_FALSE(browser("second", kNow + Store::kBrowserLasts));
    EXPECT_TRUE(store_->browsersOf(ann_, kNow + Store::kBrowserLasts).empty());
}

TEST_P(StoreBrowsers, RevokingAllSecretsOfAPerson_SignsOut_AndVoidsLinks) {
    ASSERT_TRUE(store_->addSignIn(ann_, "used", kNow));
    ASSERT_EQ(store_->signIn("used", "session", kNow), SignIn::Done);
    ASSERT_TRUE(store_->addSignIn(ann_, "unused", kNow));
    ASSERT_TRUE(store_->addSignIn(otto_, "otto's", kNow));
    store_->revokeDevices(ann_, kNow);
    EXPECT_FALSE(browser("session"));
    EXPECT_EQ(store_->signIn("unused", "later", kNow), SignIn::Spent);
    EXPECT_EQ(store_->signIn("otto's", "later", kNow), SignIn::Done);
}

TEST_P(StoreBrowsers, PhonesSecret_IsNoSession_AndASessionNoPhones) {
    EXPECT_FALSE(browser("ann's"));
    EXPECT_EQ(store_->signIn("ann's", "session", kNow), SignIn::Spent);
    ASSERT_TRUE(store_->addSignIn(ann_, "link", kNow));
    ASSERT_EQ(store_->signIn("link", "session", kNow), SignIn::Done);
    bool failed = false;
    EXPECT_FALSE(store_->deviceOf("session", failed));
    EXPECT_FALSE(failed);
}

INSTANTIATE_TEST_SUITE_P(Sqlite, StoreBrowsers, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, StoreBrowsers, ::testing::Values(true));

}  // namespace ktr::test
