// How often an answer waits for a PostgreSQL server: on a busy machine, or with a network between, that is what it
// costs.
#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "server/http/BasicCredentials.h"
#include "server/service/Service.h"
#include "tests/support/RawClient.h"
#include "tests/unit/server/CountingRelay.h"
#include "tests/unit/server/StoreContract.h"

namespace ktr::test {

using server::BasicCredentials;
using server::DeviceKind;
using server::Fix;
using server::Precision;
using server::Service;
using server::Store;

/// Otto may see some who are seen exactly, and some by town and by kilometre who never rested.
class RoundTrips : public StoreContract {
  protected:
    static constexpr std::int64_t kDay = 86400;
    /// What began at first has begun longer ago than fixes are kept.
    static constexpr std::int64_t kLater = kNow + 3 * kDay + 60;

    void SetUp() override {
        StoreContract::SetUp();
        if (IsSkipped() || HasFatalFailure()) {
            return;
        }
        std::vector<std::int64_t> people;
        for (int i = 0; i < 12; ++i) {
            const std::string name = "p" + std::to_string(i);
            handles_.push_back(name + "@x.example");
            ASSERT_TRUE(store_->addPerson(name, {handles_.back()}, kNow));
            people.push_back(store_->personNamed(name)->id);
            ASSERT_TRUE(store_->grant(people.back(), otto_, {static_cast<Precision>(i % 3), kNow, std::nullopt}));
        }
        // Each is heard when it was: none comes late.
        for (std::int64_t time = kNow + kDay; time < kLater; time += 600) {
            for (const std::int64_t person : people) {
                const Fix fix{time, time, 50.0, static_cast<double>(time % 100000) / 1000.0, 12.0};
                store_->keep(0, person, {fix}, time, nullptr);
            }
        }
        store_->finish();
        ASSERT_TRUE(store_->addDevice(otto_, DeviceKind::Reader, "otto's ktr", "", kNow));
        const std::string host = "host=";
        const std::size_t at = address_.text.find(host) + host.size();
        const std::size_t end = address_.text.find('&', at);
        relay_ = std::make_unique<CountingRelay>(address_.text.substr(at, end - at), folder_.path().string());
        ASSERT_TRUE(relay_->isListening());
        address_.text.replace(at, end - at, folder_.path().string());
        openThroughRelay();
        // Connections are set up, statements known.
        ASSERT_TRUE(store_->asked(otto_, handles_, kLater));
    }
    void openThroughRelay() {
        open();
        // A store's first connection writes, its second reads.
        reading_ = relay_->connections() - 1;
    }
    /// How often `call` waits.
    template <class Call>
    int waysOf(Call call) {
        const int before = relay_->waysOf(reading_);
        call();
        return relay_->waysOf(reading_) - before;
    }

    std::size_t reading_ = 0;
    std::vector<std::string> handles_;
    std::unique_ptr<CountingRelay> relay_;
};
INSTANTIATE_TEST_SUITE_P(Postgres, RoundTrips, ::testing::Values(true));

TEST_P(RoundTrips, OfALook_AreTwo) {
    for (const std::size_t count : {std::size_t{1}, std::size_t{3}, handles_.size()}) {
        const std::vector<std::string> some(handles_.begin(), handles_.begin() + static_cast<std::ptrdiff_t>(count));
        EXPECT_EQ(waysOf([&] {
                      const auto asked = store_->asked(otto_, some, kLater);
                      ASSERT_TRUE(asked);
                      for (const server::Asked& one : *asked) {
                          EXPECT_FALSE(one.sharing.fixes.empty()) << wordOf(one.sharing.grant->precision);
                      }
                  }),
                  2)
            << count << ": who they are; where they are";
    }
}

TEST_P(RoundTrips, OfAFirstLookThatIsFarBack_AreFew) {
    openThroughRelay();
    const int ways = waysOf([&] { ASSERT_TRUE(store_->asked(otto_, handles_, kLater)); });
    EXPECT_GT(ways, 2) << "else nothing is tried";
    EXPECT_LE(ways, 11);
    EXPECT_EQ(waysOf([&] { ASSERT_TRUE(store_->asked(otto_, handles_, kLater)); }), 2);
}

TEST_P(RoundTrips, OfAnAnswer_AreThree) {
    Service::Setup setup;
    setup.store = std::move(store_);
    setup.now = [] { return kLater; };
    setup.holdsAnswers = true;
    Service service(std::move(setup));
    ASSERT_EQ(service.start(), "");
    std::string body = R"({"clientContext":{},"handles":[)";
    for (const std::string& handle : handles_) {
        body += (body.back() == '[' ? "\"" : ",\"") + handle + "\"";
    }
    body += "]}";
    const auto answer = [&] {
        const RawClient client(service.port());
        client.send("POST /qloxservice/friends/va/getlocations HTTP/1.1\r\nHost: localhost\r\nAuthorization: " +
                    BasicCredentials{"otto", "otto's ktr"}.header() +
                    "\r\nX-Orcha-Seek-API-Ver: 4.0\r\nX-Orcha-AuthScheme: Forever\r\nContent-Type: application/json\r\n"
                    "Content-Length: " +
                    std::to_string(body.size()) + "\r\nConnection: close\r\n\r\n" + body);
        return client.read("\x01");
    };
    EXPECT_NE(answer().find("\"latitude\":50"), std::string::npos) << answer();
    // Once it listens to other processes everything may have changed: what is known is found out anew.
    int ways = waysOf(answer);
    for (int again = 0; again < 20 && ways != 3; ++again) {
        ways = waysOf(answer);
    }
    EXPECT_EQ(ways, 3) << "whose secret it is; who they are; where they are";
    service.stop();
}

}  // namespace ktr::test
