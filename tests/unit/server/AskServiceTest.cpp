#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <string>

#include "server/http/BasicCredentials.h"
#include "server/service/Service.h"
#include "tests/support/RawClient.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/unit/server/FaultyDisk.h"
#include "tests/unit/server/PrivatePostgres.h"

namespace ktr::test {

using server::BasicCredentials;
using server::DeviceKind;
using server::Grant;
using server::Precision;
using server::Service;
using server::Store;

/// A service over plain HTTP on this machine, on either kind of store: ann, otto and mara have readers, and nobody sees
/// anybody.
class AskServiceTest : public ::testing::TestWithParam<bool> {
  protected:
    static constexpr std::int64_t kNow = 1763760000;

    void SetUp() override {
        std::string complaint;
        server::StoreAddress address{folder_.path().string()};
        if (GetParam()) {
            PrivatePostgres* const server = PrivatePostgres::shared();
            if (server == nullptr) {
                GTEST_SKIP() << "needs a PostgreSQL server: KTR_LONG_TESTS=1 starts one";
            }
            address = {server->newStore()};
        }
        store_ = Store::open(address, true, complaint);
        ASSERT_TRUE(store_) << complaint;
        for (const char* name : {"ann", "otto", "mara"}) {
            ASSERT_TRUE(store_->addPerson(name, {std::string(name) + "@x.example"}, kNow));
            ids_[name] = store_->personNamed(name)->id;
            ASSERT_TRUE(store_->addDevice(ids_[name], DeviceKind::Reader, std::string(name) + "'s ktr", "", kNow));
        }
        Service::Setup setup;
        setup.store = store_;
        setup.now = [this] { return now_; };
        service_ = std::make_unique<Service>(std::move(setup));
        ASSERT_EQ(service_->start(), "");
    }
    void TearDown() override {
        if (service_) {
            service_->stop();
        }
    }
    /// Status line and body.
    std::string ask(const std::string& who, const std::string& path, const std::string& members) {
        const std::string body = R"({"clientContext":{})" + members + "}";
        const RawClient client(service_->port());
        client.send("POST /qloxservice/friends/va/" + path +
                    " HTTP/1.1\r\nHost: localhost\r\nAuthorization: " + BasicCredentials{who, who + "'s ktr"}.header() +
                    "\r\nX-Orcha-Seek-API-Ver: 4.0\r\nX-Orcha-AuthScheme: Forever\r\nContent-Type: application/json\r\n"
                    "Content-Length: " +
                    std::to_string(body.size()) + "\r\nConnection: close\r\n\r\n" + body);
        return client.read("\x01");
    }
    static bool holds(const std::string& text, const std::string& part) { return text.find(part) != std::string::npos; }

    TemporaryFolder folder_;
    FaultyDisk disk_;
    std::shared_ptr<Store> store_;
    std::unique_ptr<Service> service_;
    std::map<std::string, std::int64_t> ids_;
    std::int64_t now_ = kNow;
};

INSTANTIATE_TEST_SUITE_P(Sqlite, AskServiceTest, ::testing::Values(false));
INSTANTIATE_TEST_SUITE_P(Postgres, AskServiceTest, ::testing::Values(true));

TEST_P(AskServiceTest, ARuleForOne_IsMadeWithItsEndAndPrecisionAndTaken) {
    const std::string shared =
        ask("ann", "sharing", R"(,"wish":"share","with":["otto@x.example"],"until":1763763600000,"precision":"town")");
    EXPECT_TRUE(holds(shared, " 200 ")) << shared;
    const std::string told = ask("ann", "sharing", R"(,"wish":"read")");
    EXPECT_TRUE(holds(told, R"("viewers":[{"name":"otto","precision":"town","until":1763763600000}])")) << told;
    const auto rules = store_->grantsOf(ids_["ann"]);
    ASSERT_EQ(rules.size(), 1U);
    EXPECT_EQ(rules.front().second.precision, Precision::Town);
    EXPECT_EQ(rules.front().second.until, 1763763600);
    const std::string ended = ask("ann", "sharing", R"(,"wish":"hide","with":["otto@x.example"])");
    EXPECT_TRUE(holds(ended, " 200 ")) << ended;
    EXPECT_TRUE(holds(ask("ann", "sharing", R"(,"wish":"read")"), R"("viewers":[])"));
    EXPECT_TRUE(store_->grantsOf(ids_["ann"]).empty());
}

TEST_P(AskServiceTest, WhatAWishDoesNotName_StaysAsItWasAgreed) {
    Grant grant{Precision::Kilometre, kNow - 500, std::nullopt};
    grant.aloud = true;
    ASSERT_TRUE(store_->grant(ids_["ann"], ids_["otto"], grant));
    ask("ann", "sharing", R"(,"wish":"share","with":["otto@x.example"],"until":1763763600000)");
    const auto rules = store_->grantsOf(ids_["ann"]);
    ASSERT_EQ(rules.size(), 1U);
    EXPECT_EQ(rules.front().second.precision, Precision::Kilometre);
    EXPECT_TRUE(rules.front().second.aloud);
}

TEST_P(AskServiceTest, OfARuleThatIsOver_NoLeaveComesBackByItself) {
    Grant grant{Precision::Town, kNow - 500, kNow - 100};
    grant.aloud = grant.fences = true;
    ASSERT_TRUE(store_->grant(ids_["ann"], ids_["otto"], grant));
    ask("ann", "sharing", R"(,"wish":"share","with":["otto@x.example"])");
    const auto rules = store_->grantsOf(ids_["ann"]);
    ASSERT_EQ(rules.size(), 1U);
    EXPECT_EQ(rules.front().second.precision, Precision::Town);
    EXPECT_FALSE(rules.front().second.aloud);
    EXPECT_FALSE(rules.front().second.fences);
    EXPECT_GE(rules.front().second.from, kNow) << "nothing from before is seen";
}

TEST_P(AskServiceTest, ARuleForSomebody_IsAnsweredAlikeWhoeverIsThere) {
    ASSERT_TRUE(store_->setHidden(ids_["mara"], true, kNow));
    ASSERT_TRUE(store_->grant(ids_["otto"], ids_["ann"], {Precision::Exact, kNow, std::nullopt}));
    const auto wished = [this](const std::string& wish, const std::string& handle) {
        return ask("ann", "sharing", R"(,"wish":")" + wish + R"(","with":[")" + handle + R"("])");
    };
    for (const char* wish : {"hide", "share", "share", "hide"}) {
        const std::string nobody = wished(wish, "nobody@x.example");
        EXPECT_TRUE(holds(nobody, "200 OK")) << nobody;
        EXPECT_FALSE(holds(nobody, "viewers")) << nobody;
        EXPECT_EQ(wished(wish, "otto@x.example"), nobody) << wish << ": shares";
        EXPECT_EQ(wished(wish, "mara@x.example"), nobody) << wish << ": a stranger, who hides";
        EXPECT_EQ(wished(wish, "ann@x.example"), nobody) << wish << ": oneself";
        EXPECT_EQ(wished(wish, "+1 555 0100"), nobody) << wish << ": a number of nobody's";
        EXPECT_EQ(wished(wish, "+"), nobody) << wish << ": no number at all";
        EXPECT_EQ(store_->grantsOf(ids_["ann"]).size(), wish[0] == 's' ? 2U : 0U) << wish;
    }
}

TEST_P(AskServiceTest, OneWhomTheServiceDoesNotHave_KeepsNobodyElseFromTheRule) {
    ask("ann", "sharing", R"(,"wish":"share","with":["nobody@x.example","otto@x.example","ann@x.example"])");
    ASSERT_EQ(store_->grantsOf(ids_["ann"]).size(), 1U);
    EXPECT_EQ(store_->grantsOf(ids_["ann"]).front().first, "otto");
    EXPECT_EQ(store_->sharing(ids_["ann"], ids_["ann"])->grant, std::nullopt) << "nobody shares with themself";
    ask("ann", "sharing", R"(,"wish":"hide","with":["nobody@x.example","otto@x.example"])");
    EXPECT_TRUE(store_->grantsOf(ids_["ann"]).empty());
}

TEST_P(AskServiceTest, Hiding_HoldsBeforeTheAnswerUntilOneIsShownAgain) {
    EXPECT_TRUE(holds(ask("ann", "sharing", R"(,"wish":"hide")"), R"("hidden":true)"));
    EXPECT_TRUE(store_->person(ids_["ann"])->hidden);
    EXPECT_TRUE(holds(ask("ann", "sharing", R"(,"wish":"read")"), R"("hidden":true)"));
    EXPECT_TRUE(holds(ask("ann", "sharing", R"(,"wish":"share")"), R"("hidden":false)"));
    EXPECT_FALSE(store_->person(ids_["ann"])->hidden);
}

TEST_P(AskServiceTest, AskingChangesNothing_AndWhatIsNoWishIsRefused) {
    ask("ann", "sharing", R"(,"wish":"read","with":["otto@x.example"])");
    EXPECT_TRUE(store_->grantsOf(ids_["ann"]).empty());
    for (const char* members :
         {"", R"(,"wish":"destroy")", R"(,"wish":"share","until":1763763600000)",
          R"(,"wish":"share","with":["otto@x.example"],"precision":"close")",
          R"(,"wish":"share","with":"otto@x.example")", R"(,"wish":"share","with":[""])",
          R"(,"wish":"hide","with":["a\u0000b"])", R"(,"wish":"hide","with":["otto@x.example"],"until":1)"}) {
        EXPECT_TRUE(holds(ask("ann", "sharing", members), " 400 ")) << members;
    }
    EXPECT_TRUE(store_->grantsOf(ids_["ann"]).empty());
}

TEST_P(AskServiceTest, WhatCannotBeTakenBack_IsNotSaidToBe) {
    if (GetParam()) {
        GTEST_SKIP() << "the disk is that of a file";
    }
    const std::string hide = R"(,"wish":"hide","with":["otto@x.example"])";
    EXPECT_TRUE(holds(ask("ann", "sharing", hide), " 200 ")) << "there is nothing to be ended";
    ASSERT_TRUE(store_->grant(ids_["ann"], ids_["otto"], Grant{Precision::Exact, kNow, std::nullopt}));
    disk_.setBroken(true);
    EXPECT_TRUE(holds(ask("ann", "sharing", hide), " 503 "));
    disk_.setBroken(false);
    EXPECT_TRUE(holds(ask("ann", "sharing", hide), " 200 "));
    EXPECT_TRUE(store_->grantsOf(ids_["ann"]).empty());
}

TEST_P(AskServiceTest, Places_AreTheAskersOwnAlone) {
    server::NamedPlace place;
    place.name = "Our house";
    place.label = "home";
    place.latitude = 50.2;
    place.longitude = -3.1;
    place.said = true;
    ASSERT_TRUE(store_->setPlace(ids_["ann"], place));
    ASSERT_TRUE(store_->grant(ids_["ann"], ids_["otto"], Grant{Precision::Exact, kNow - 1000, std::nullopt}));
    const std::string own = ask("ann", "places", "");
    EXPECT_TRUE(holds(own, R"({"name":"Our house","latitude":50.2,"longitude":-3.1})")) << own;
    EXPECT_TRUE(holds(own, R"({"name":"_$!<home>!$_")")) << own;
    EXPECT_TRUE(holds(ask("otto", "places", ""), R"("places":[])"));
}

TEST_P(AskServiceTest, Friends_AreThoseWhosePlaceWouldBeTold_AndNobodyElse) {
    ASSERT_TRUE(store_->grant(ids_["otto"], ids_["ann"], {Precision::Exact, kNow - 500, std::nullopt}));
    ASSERT_TRUE(store_->grant(ids_["mara"], ids_["ann"], {Precision::Exact, kNow - 500, std::nullopt}));
    EXPECT_TRUE(holds(ask("ann", "friends", ""), R"({"statusCode":200,"friends":[]})")) << "nobody was heard yet";
    for (const char* name : {"otto", "mara"}) {
        store_->keep(0, ids_[name], {{kNow + 1, kNow + 1, 50.2, -3.1, 10.0}}, kNow + 1, nullptr);
    }
    store_->finish();
    now_ = kNow + 10;
    const std::string both = ask("ann", "friends", "");
    EXPECT_TRUE(holds(both, R"({"name":"otto","handle":"otto@x.example"})")) << both;
    EXPECT_TRUE(holds(both, R"({"name":"mara","handle":"mara@x.example"})")) << both;
    EXPECT_FALSE(holds(both, "50.2")) << "where anybody is is another question";
    ASSERT_TRUE(store_->setHidden(ids_["mara"], true, now_));
    ASSERT_TRUE(store_->revokeGrant(ids_["otto"], ids_["ann"]));
    EXPECT_TRUE(holds(ask("ann", "friends", ""), R"("friends":[]})")) << "hiding and ending look the same";
    EXPECT_TRUE(holds(ask("otto", "friends", ""), R"("friends":[]})"));
    EXPECT_TRUE(store_->looksAt(ids_["otto"]).empty());
}

TEST_P(AskServiceTest, AskingToShare_IsAnsweredAlikeWhoeverIsThere) {
    ASSERT_TRUE(store_->grant(ids_["otto"], ids_["mara"], {Precision::Exact, kNow, std::nullopt}));
    ASSERT_TRUE(store_->setHidden(ids_["otto"], true, kNow));
    const auto asked = [this](const char* handle) {
        return ask("mara", "askToShare", R"(,"handles":[")" + std::string(handle) + R"("])");
    };
    const std::string first = asked("ann@x.example");
    EXPECT_TRUE(holds(first, "200 OK")) << first;
    EXPECT_TRUE(holds(first, R"({"statusCode":200})")) << first;
    EXPECT_EQ(asked("ann@x.example"), first) << "asked already";
    EXPECT_EQ(asked("nobody@x.example"), first);
    EXPECT_EQ(asked("otto@x.example"), first) << "hides";
    EXPECT_EQ(asked("mara@x.example"), first) << "oneself";
    EXPECT_EQ(store_->askersOf(ids_["ann"], kNow)->size(), 1U);
    for (const char* wrong : {"", R"(,"handles":[])", R"(,"handles":[""])", R"(,"handles":"ann@x.example")",
                              R"(,"handles":["a\u0000b"])", R"(,"handle":"ann@x.example")"}) {
        EXPECT_TRUE(holds(ask("mara", "askToShare", wrong), " 400 ")) << wrong;
    }
}

}  // namespace ktr::test
